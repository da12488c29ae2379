import QtQuick 2.15
import QtQuick.Layouts 1.15
import Orlex.Controls 1.0
import Orlex.Theme 1.0

// The segments of both subjects.
ColumnLayout {
	id: segments

	property Item panel: null
	property Item menu: null
	readonly property alias sourceList: sourceSegments
	readonly property alias targetList: targetSegments
	readonly property alias sourceCount: sourceSegments.count
	readonly property alias targetCount: targetSegments.count

	spacing: 0

	OrlexLabel {
		Layout.margins: Theme.spacing
		Layout.fillWidth: true
		text: "Source Segments"
		color: Theme.windowText
	}
	RetargetSetupSegmentList {
		id: sourceSegments
		objectName: "sourceSegments"
		Layout.fillWidth: true
		Layout.fillHeight: true
		title: "Source Segments"
		model: SourceSegmentModel
		mappingOf: name => segments.panel.mappingOf(name, true)
		selectedIndex: RetargetSetupSelection.selectedSourceSegment
		onMenuRequested: segments.menu.openForSegments(true, item, x, y)
	}
	OrlexLabel {
		Layout.margins: Theme.spacing
		Layout.fillWidth: true
		text: "Target Segments"
		color: Theme.bright
	}
	RetargetSetupSegmentList {
		id: targetSegments
		objectName: "targetSegments"
		Layout.fillWidth: true
		Layout.fillHeight: true
		title: "Target Segments"
		model: TargetSegmentModel
		marksJoints: true
		mappingOf: name => segments.panel.mappingOf(name, false)
		selectedIndex: RetargetSetupSelection.selectedTargetSegment
		onMenuRequested: segments.menu.openForSegments(false, item, x, y)
	}
}
