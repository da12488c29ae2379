import QtQuick 2.15
import Orlex.Theme 1.0

// Lies over a whole panel while files hang over it, and tells where they go.
Rectangle {
	id: mark

	// A line for each file.
	property string text: ""
	// Rectangles of the panel.
	property var places: []

	objectName: "dropMark"
	anchors.fill: parent
	z: 1
	color: "transparent"
	border.width: 2
	border.color: Theme.active
	Accessible.role: Accessible.AlertMessage
	Accessible.name: text

	Repeater {
		model: mark.places
		Rectangle {
			x: modelData.x - 4
			y: modelData.y - 4
			width: modelData.width + 8
			height: modelData.height + 8
			color: "transparent"
			border.width: 2
			border.color: Theme.active
			radius: Theme.radius
		}
	}
	Rectangle {
		anchors.fill: caption
		anchors.margins: -2 * Theme.margin
		color: Theme.dark
		border.color: Theme.active
		radius: Theme.radius
	}
	Column {
		id: caption
		anchors.centerIn: parent
		spacing: Theme.spacing

		Repeater {
			model: mark.text.split("\n")
			Text {
				width: Math.min(implicitWidth, mark.width - 6 * Theme.margin)
				text: modelData
				textFormat: Text.PlainText
				elide: Text.ElideMiddle
				font.pixelSize: Theme.fontSize + 2
				color: Theme.bright
			}
		}
	}
}
