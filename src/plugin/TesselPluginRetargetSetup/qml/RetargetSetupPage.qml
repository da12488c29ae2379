import QtQuick 2.15
import QtQuick.Controls 2.15
import QtQuick.Layouts 1.15
import QtQuick.Window 2.15
import Orlex.Controls 1.0
import Orlex.Theme 1.0

// A column of controls that scrolls where it is too long for its place.
Item {
	id: page

	default property alias content: column.data
	// Of the content, without what stands round it.
	property real contentWidth: 0
	readonly property real minimumWidth: Math.ceil(contentWidth) + 2 * Theme.margin + bar.width
	// The mouse, also over what is disabled.
	readonly property bool pointing: behind.containsMouse
	readonly property point place: Qt.point(behind.mouseX, behind.mouseY)

	// A disabled control lets the mouse through.
	MouseArea {
		id: behind
		anchors.fill: parent
		hoverEnabled: true
		acceptedButtons: Qt.NoButton
	}

	Flickable {
		id: view
		objectName: "leftView"
		anchors.fill: parent
		contentHeight: column.height + 2 * Theme.margin
		boundsBehavior: Flickable.StopAtBounds
		interactive: contentHeight > height
		clip: true
		ScrollBar.vertical: OrlexScrollBar {
			id: bar
		}

		// Scrolls until an item of the column can be seen.
		function reveal(item) {
			for (let parent = item; parent !== column; parent = parent.parent)
				if (!parent)
					return
			const top = item.mapToItem(column, 0, 0).y
			contentY = Math.max(Math.min(contentY, top), top + item.height + 2 * Theme.margin - height)
		}

		readonly property Item focusItem: Window.activeFocusItem
		onFocusItemChanged: reveal(focusItem)

		ColumnLayout {
			id: column
			x: Theme.margin
			y: Theme.margin
			width: view.width - 2 * Theme.margin - (view.interactive ? bar.width : 0)
			height: Math.max(implicitHeight, view.height - 2 * Theme.margin)
			spacing: Theme.spacing
		}
	}
}
