import QtQuick 2.15
import Orlex.Controls 1.0
import Orlex.Theme 1.0

// A line that tells why what the mouse points at is disabled, else what a command did not do and why, else what comes
// next. A control that can be disabled says why in its property "disabledReason".
Item {
	id: status

	// Where the mouse is looked for, and where it is there.
	property Item page: null
	property point place
	property bool pointing: false
	// Why the last command did nothing; until something else happens.
	property string told: ""
	property string next: ""

	readonly property Item disabledItem: pointing && page ? disabledAt(page, place.x, place.y) : null
	readonly property string text: disabledItem ? disabledItem.disabledReason : told !== "" ? told : next

	function disabledAt(item, x, y) {
		const child = item.childAt(x, y)
		if (!child || !child.enabled && child.disabledReason)
			return child
		const inside = item.mapToItem(child, x, y)
		return disabledAt(child, inside.x, inside.y)
	}

	implicitHeight: Theme.itemHeight
	Accessible.role: Accessible.StatusBar
	Accessible.name: text

	OrlexLabel {
		anchors.fill: parent
		anchors.leftMargin: Theme.margin
		anchors.rightMargin: Theme.margin
		text: status.text
		color: status.disabledItem || status.told === "" ? Theme.windowText : Theme.warning
		Accessible.ignored: true
	}
	OrlexToolTip {
		parent: status.disabledItem || status
		visible: status.disabledItem !== null
		text: status.disabledItem ? [status.disabledItem.toolTip, status.text].filter(line => line).join("\n") : ""
	}
}
