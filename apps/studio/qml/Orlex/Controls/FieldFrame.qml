import QtQuick 2.15
import Orlex.Theme 1.0

// The ground of everything that is typed into or picked from.
Rectangle {
	property bool focused: false
	property bool hovered: false
	property bool invalid: false

	implicitHeight: Theme.controlHeight
	implicitWidth: 120
	radius: Theme.radius
	color: enabled ? Theme.base : Theme.window
	border.width: 1
	border.color: invalid ? Theme.error : focused ? Theme.active : hovered && enabled ? Theme.disabledText
		: enabled ? Theme.border : Theme.button
}
