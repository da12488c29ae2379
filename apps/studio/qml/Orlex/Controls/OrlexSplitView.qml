import QtQuick 2.15
import QtQuick.Templates 2.15 as T
import Orlex.Controls 1.0
import Orlex.Theme 1.0

// Columns or rows whose borders can be dragged. Children say their size by SplitView's attached properties.
T.SplitView {
	id: control

	implicitWidth: implicitContentWidth + leftPadding + rightPadding
	implicitHeight: implicitContentHeight + topPadding + bottomPadding

	handle: Rectangle {
		implicitWidth: 6
		implicitHeight: 6
		Component.onCompleted: Ownership.giveTo(this, control)
		color: T.SplitHandle.pressed ? Theme.active : T.SplitHandle.hovered ? Theme.border : Theme.dark

		Rectangle {
			anchors.centerIn: parent
			readonly property bool upright: control.orientation === Qt.Horizontal
			width: upright ? 2 : 24
			height: upright ? 24 : 2
			radius: 1
			color: parent.T.SplitHandle.pressed ? Theme.bright : Theme.disabledText
		}
	}
}
