import QtQuick 2.15

// What a control says under the mouse: its whole text where that is cut, and its tool tip.
Loader {
	id: tip

	property bool hovered: false
	property bool cut: false
	property string whole: ""
	property string toolTip: ""

	active: hovered && (cut || toolTip !== "")
	sourceComponent: OrlexToolTip {
		parent: tip.parent
		visible: true
		text: !tip.cut ? tip.toolTip : tip.toolTip !== "" ? tip.whole + "\n" + tip.toolTip : tip.whole
	}
}
