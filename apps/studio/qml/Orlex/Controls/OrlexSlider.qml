import QtQuick 2.15
import QtQuick.Templates 2.15 as T
import Orlex.Theme 1.0

T.Slider {
	id: control

	implicitWidth: 120
	implicitHeight: Theme.controlHeight
	leftPadding: 2
	rightPadding: 2
	hoverEnabled: true
	// The wheel scrolls what the slider stands in.
	wheelEnabled: false
	Accessible.role: Accessible.Slider

	background: Rectangle {
		x: control.leftPadding
		y: Math.round((control.height - height) / 2)
		width: control.availableWidth
		height: 4
		radius: 2
		color: control.enabled ? Theme.base : Theme.window
		border.color: control.enabled ? Theme.border : Theme.button

		Rectangle {
			width: control.handle.x - parent.x + control.handle.width / 2
			height: parent.height
			radius: 2
			color: control.enabled ? Theme.active : Theme.button
		}
	}
	handle: Rectangle {
		x: Math.round(control.leftPadding + control.visualPosition * (control.availableWidth - width))
		y: Math.round((control.height - height) / 2)
		width: 10
		height: 16
		radius: Theme.radius
		color: !control.enabled ? Theme.mid : control.pressed ? Theme.active
			: control.hovered ? Theme.windowText : Theme.disabledText
		border.color: control.enabled ? Theme.dark : Theme.button

		FocusRing {
			visible: control.visualFocus
		}
	}
}
