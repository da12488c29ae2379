import QtQuick 2.15
import Orlex.Theme 1.0

// Around a control that has the keyboard.
Rectangle {
	anchors.fill: parent
	anchors.margins: -2
	color: "transparent"
	border.color: Theme.active
	border.width: 1
	radius: Theme.radius + 2
}
