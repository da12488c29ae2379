import QtQuick 2.15
import Orlex.Theme 1.0

// One line of text; a long one loses its middle, so that both ends of a name can be told apart, and shows the whole
// under the mouse.
Text {
	id: label

	// Shown under the mouse, before the whole text if that is cut.
	property string toolTip: ""
	// False where the row around it shows the tool tip.
	property bool ownToolTip: true

	color: enabled ? Theme.windowText : Theme.disabledText
	font.pixelSize: Theme.fontSize
	textFormat: Text.PlainText
	elide: Text.ElideMiddle
	verticalAlignment: Text.AlignVCenter
	Accessible.role: Accessible.StaticText
	Accessible.name: text

	HoverHandler {
		id: hover
		enabled: label.ownToolTip
	}
	HoverTip {
		hovered: hover.hovered
		cut: label.truncated
		whole: label.text
		toolTip: label.toolTip
	}
}
