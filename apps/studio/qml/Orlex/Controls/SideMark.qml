import QtQuick 2.15
import Orlex.Controls 1.0
import Orlex.Theme 1.0

// A small "L" or "R" beside a name of the left or the right side; nothing beside any other.
Rectangle {
	id: mark

	property string name: ""
	readonly property string side: Side.of(name)

	visible: side !== ""
	implicitWidth: 13
	implicitHeight: 13
	radius: 2
	color: Theme.dark
	border.width: 1
	border.color: side === "L" ? "#6f9ccf" : "#d99a6a"
	Accessible.ignored: true

	Text {
		anchors.centerIn: parent
		text: mark.side
		font.pixelSize: 9
		font.bold: true
		color: mark.border.color
	}
}
