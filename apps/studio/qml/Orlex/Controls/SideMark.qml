import QtQuick 2.15
import Orlex.Theme 1.0

// A small "L" or "R" beside a name of the left or the right side; nothing beside any other.
Rectangle {
	id: mark

	property string name: ""
	// "L", "R" or empty.
	readonly property string side: sideOf(name)

	function sideOf(name) {
		// A word of its own ("LeftArm", "arm_l", "L_Arm"), behind any name space.
		const plain = name.slice(name.lastIndexOf(":") + 1)
		const words = plain.replace(/([a-z0-9])([A-Z])/g, "$1 $2").replace(/([A-Z])([A-Z][a-z])/g, "$1 $2").toLowerCase()
			.split(/[^a-z]+/)
		const left = words.some(word => word === "l" || word === "left")
		const right = words.some(word => word === "r" || word === "right")
		return left === right ? "" : left ? "L" : "R"
	}

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
