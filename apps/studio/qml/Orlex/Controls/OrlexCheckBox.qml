import QtQuick 2.15
import QtQuick.Templates 2.15 as T
import Orlex.Theme 1.0

T.CheckBox {
	id: control

	property string toolTip: ""

	implicitWidth: Math.ceil(caption.implicitWidth) + leftPadding + rightPadding
	implicitHeight: Theme.controlHeight
	padding: 2
	font.pixelSize: Theme.fontSize
	hoverEnabled: true
	Accessible.role: Accessible.CheckBox
	Accessible.name: text
	Accessible.description: toolTip
	Accessible.checked: checked
	Accessible.onToggleAction: act()
	Accessible.onPressAction: act()

	// What a click does; the default of these actions tells nobody.
	function act() {
		if (!enabled)
			return
		toggle()
		toggled()
		clicked()
	}

	indicator: Rectangle {
		x: control.leftPadding
		y: Math.round((control.height - height) / 2)
		width: 14
		height: 14
		radius: 2
		color: !control.enabled ? Theme.window : control.checked ? Theme.active : control.down ? Theme.button : Theme.base
		border.width: 1
		border.color: !control.enabled ? Theme.button : control.checked ? Theme.active
			: control.hovered ? Theme.disabledText : Theme.border

		Item {
			// Two strokes of a turned corner.
			anchors.centerIn: parent
			anchors.verticalCenterOffset: -1
			width: 5
			height: 9
			rotation: 45
			visible: control.checked
			Repeater {
				model: [[3, 0, 2, 9], [0, 7, 5, 2]]
				Rectangle {
					x: modelData[0]
					y: modelData[1]
					width: modelData[2]
					height: modelData[3]
					antialiasing: true
					color: control.enabled ? Theme.bright : Theme.disabledText
				}
			}
		}
		FocusRing {
			visible: control.visualFocus
		}
	}

	contentItem: Text {
		id: caption
		leftPadding: control.text !== "" ? 14 + 6 : 14
		text: control.text
		textFormat: Text.PlainText
		font: control.font
		color: control.enabled ? Theme.windowText : Theme.disabledText
		verticalAlignment: Text.AlignVCenter
		elide: Text.ElideRight
	}

	HoverTip {
		hovered: control.hovered && !control.down
		cut: caption.truncated
		whole: control.text
		toolTip: control.toolTip
	}
}
