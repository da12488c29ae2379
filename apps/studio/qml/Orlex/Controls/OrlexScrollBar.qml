import QtQuick 2.15
import QtQuick.Templates 2.15 as T
import Orlex.Theme 1.0

T.ScrollBar {
	id: control

	implicitWidth: 10
	implicitHeight: 10
	padding: 2
	minimumSize: Math.min(1, 24 / Math.max(24, orientation === Qt.Horizontal ? width : height))
	visible: size < 1
	Accessible.ignored: true

	contentItem: Rectangle {
		implicitWidth: 6
		implicitHeight: 6
		radius: 3
		color: control.pressed ? Theme.active : control.hovered ? Theme.disabledText : Theme.border
	}
	background: Rectangle {
		color: Theme.dark
	}
}
