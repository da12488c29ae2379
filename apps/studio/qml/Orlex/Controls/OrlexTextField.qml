import QtQuick 2.15
import QtQuick.Templates 2.15 as T
import Orlex.Theme 1.0

T.TextField {
	id: control

	// Why what stands in the field was refused; empty if it was not.
	property string error: ""
	property string toolTip: ""

	implicitWidth: 120
	implicitHeight: Theme.controlHeight
	leftPadding: 6
	rightPadding: 6
	font.pixelSize: Theme.fontSize
	color: enabled ? Theme.text : Theme.disabledText
	selectionColor: Theme.highlight
	selectedTextColor: Theme.bright
	placeholderTextColor: Theme.disabledText
	verticalAlignment: TextInput.AlignVCenter
	selectByMouse: true
	hoverEnabled: true
	Accessible.role: Accessible.EditableText
	Accessible.name: placeholderText
	Accessible.description: error !== "" ? error : toolTip

	background: FieldFrame {
		focused: control.activeFocus
		hovered: control.hovered
		invalid: control.error !== ""
	}

	Text {
		anchors.fill: parent
		anchors.leftMargin: control.leftPadding
		anchors.rightMargin: control.rightPadding
		visible: control.length === 0 && control.preeditText === ""
		text: control.placeholderText
		textFormat: Text.PlainText
		font: control.font
		color: control.placeholderTextColor
		verticalAlignment: Text.AlignVCenter
		elide: Text.ElideRight
	}

	HoverTip {
		hovered: control.hovered && !control.activeFocus
		cut: control.contentWidth > control.availableWidth
		whole: control.text
		toolTip: control.toolTip
	}
}
