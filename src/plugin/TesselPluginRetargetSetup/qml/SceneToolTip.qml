import QtQuick 2.15
import QtQuick.Controls 2.15
import Orlex.Theme 1.0

// Tells beside the mouse what it points at in a scene.
ToolTip {
	id: toolTip

	property var scene: null
	// What is told of what the scene names.
	property var describe: text => text

	// Names come from files: they stay plain text, and only what parts them becomes a line.
	text: scene ? describe(scene.toolTipText.replace(/<br>/g, "\n")) : ""
	x: scene ? scene.mousePos.x + 10 : 0
	y: scene ? scene.mousePos.y + 10 : 0
	visible: text !== ""
	delay: Theme.infoToolTipDelay
	// Escape is the view's: it ends what the mouse is about.
	closePolicy: Popup.NoAutoClose

	contentItem: Text {
		objectName: "sceneToolTip"
		text: toolTip.text
		textFormat: Text.PlainText
		color: "white"
		font.pointSize: 10
	}
	background: Rectangle {
		color: "#A0000000"
		radius: 5
	}
}
