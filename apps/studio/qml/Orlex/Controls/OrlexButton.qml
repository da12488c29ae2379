import QtQuick 2.15
import QtQuick.Templates 2.15 as T
import Orlex.Theme 1.0

T.Button {
	id: control

	property string toolTip: ""

	implicitWidth: Math.ceil(caption.implicitWidth) + leftPadding + rightPadding
	implicitHeight: Theme.controlHeight
	leftPadding: 10
	rightPadding: 10
	font.pixelSize: Theme.fontSize
	hoverEnabled: true
	Accessible.role: Accessible.Button
	Accessible.name: text
	Accessible.description: toolTip
	Accessible.checkable: checkable
	Accessible.checked: checked
	Accessible.onToggleAction: act()
	Accessible.onPressAction: act()

	// What a click does.
	function act() {
		if (!enabled)
			return
		if (checkable) {
			toggle()
			toggled()
		}
		clicked()
	}

	contentItem: Text {
		id: caption
		text: control.text
		textFormat: Text.PlainText
		font: control.font
		color: !control.enabled ? Theme.disabledText : control.checked ? Theme.bright : Theme.buttonText
		horizontalAlignment: Text.AlignHCenter
		verticalAlignment: Text.AlignVCenter
		elide: Text.ElideRight
	}

	background: Rectangle {
		radius: Theme.radius
		border.width: 1
		border.color: !control.enabled ? Theme.mid : control.checked || control.down ? Theme.active
			: control.hovered ? Theme.disabledText : Theme.border
		color: !control.enabled ? Theme.window : control.down ? Theme.active
			: control.checked ? Theme.activeGround : control.hovered ? Qt.lighter(Theme.button, 1.15) : Theme.button

		FocusRing {
			visible: control.visualFocus
		}
	}

	HoverTip {
		hovered: control.hovered && !control.down
		cut: caption.truncated
		whole: control.text
		toolTip: control.toolTip
	}
}
