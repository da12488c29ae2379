import QtQuick 2.15
import QtQuick.Templates 2.15 as T
import Orlex.Theme 1.0

// A heading that folds what belongs to it: whoever uses it binds to "checked".
T.AbstractButton {
	id: control

	checkable: true
	implicitWidth: caption.implicitWidth + 18
	implicitHeight: Theme.itemHeight
	font.pixelSize: Theme.fontSize
	hoverEnabled: true
	Accessible.role: Accessible.Button
	Accessible.name: text
	Accessible.checkable: true
	Accessible.checked: checked
	Accessible.onToggleAction: toggle()
	Accessible.onPressAction: toggle()

	contentItem: Item {
		Chevron {
			anchors.verticalCenter: parent.verticalCenter
			rotation: control.checked ? 90 : 0
			ink: control.hovered ? Theme.bright : Theme.windowText
		}
		Text {
			id: caption
			x: 16
			width: parent.width - x
			height: parent.height
			text: control.text
			textFormat: Text.PlainText
			font: control.font
			color: control.hovered ? Theme.bright : Theme.windowText
			verticalAlignment: Text.AlignVCenter
			elide: Text.ElideRight
		}
	}
	background: Item {
		FocusRing {
			anchors.margins: 0
			visible: control.visualFocus
		}
	}
}
