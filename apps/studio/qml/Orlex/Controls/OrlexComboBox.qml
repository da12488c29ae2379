import QtQuick 2.15
import Orlex.Theme 1.0

// Picks one of a list of texts. A long list can be filtered by typing: an entry stays if it holds every word typed, in
// any case. Leading spaces of an entry indent it.
Item {
	id: control

	// A list of texts.
	property var model: []
	property int currentIndex: -1
	readonly property int count: model ? model.length : 0
	readonly property string currentText: currentIndex >= 0 && currentIndex < count ? model[currentIndex].trim() : ""
	// What the closed box shows.
	property string displayText: currentText
	property string placeholderText: ""
	property string toolTip: ""
	property bool filterable: count > 12
	// Whether the arrow keys pick without the list. They open it where a pick costs time.
	property bool steps: true
	property bool invalid: false
	property color textColor: Theme.text
	readonly property alias hovered: mouse.containsMouse
	// The list is made when it opens for the first time.
	readonly property bool listed: list.item !== null && list.item.visible

	// The operator picked an entry; currentIndex is it already.
	signal activated(int index)

	function pick(index) {
		if (listed)
			list.item.close()
		if (index < 0 || index >= count)
			return
		currentIndex = index
		activated(index)
	}
	function step(by) {
		const index = Math.max(0, Math.min(count - 1, currentIndex + by))
		if (count > 0 && index !== currentIndex)
			pick(index)
	}
	// The next entry behind a place that begins with a text, around the end; -1 if there is none.
	function findFrom(index, text) {
		for (let i = 1; i <= count; ++i) {
			const at = (Math.max(index, -1) + i) % count
			if (model[at].trim().toLowerCase().startsWith(text.toLowerCase()))
				return at
		}
		return -1
	}
	function typesText(event) {
		return event.text.trim() !== "" && !(event.modifiers & (Qt.ControlModifier | Qt.AltModifier))
	}
	function open(filter) {
		list.active = true
		list.item.begin(filter)
	}

	implicitWidth: 140
	implicitHeight: Theme.controlHeight
	activeFocusOnTab: true
	Accessible.role: Accessible.ComboBox
	Accessible.focusable: true
	Accessible.name: placeholderText
	Accessible.description: displayText
	Accessible.onPressAction: open("")

	Keys.onPressed: {
		event.accepted = true
		if (event.key === Qt.Key_F4 || event.key === Qt.Key_Space || event.key === Qt.Key_Return
				|| event.key === Qt.Key_Enter || event.key === Qt.Key_Down && event.modifiers & Qt.AltModifier)
			open("")
		else if (event.key === Qt.Key_Up || event.key === Qt.Key_Down)
			steps ? step(event.key === Qt.Key_Up ? -1 : 1) : open("")
		else if (steps && (event.key === Qt.Key_Home || event.key === Qt.Key_End))
			step(event.key === Qt.Key_Home ? -count : count)
		else if (filterable && typesText(event))
			open(event.text)
		else if (typesText(event) && findFrom(currentIndex, event.text) >= 0) {
			const found = findFrom(currentIndex, event.text)
			if (steps)
				pick(found)
			else {
				open("")
				list.item.goTo(found)
			}
		}
		else
			event.accepted = false
	}

	FieldFrame {
		anchors.fill: parent
		focused: control.activeFocus || control.listed
		hovered: control.hovered
		invalid: control.invalid
		color: !control.enabled ? Theme.window : control.listed ? Theme.base : Theme.button
	}

	MouseArea {
		id: mouse
		anchors.fill: parent
		anchors.leftMargin: 6
		anchors.rightMargin: 4
		hoverEnabled: true
		onPressed: {
			control.forceActiveFocus(Qt.MouseFocusReason)
			if (control.listed)
				list.item.close()
			else
				control.open("")
		}

		Text {
			id: caption
			anchors.left: parent.left
			anchors.right: mark.visible ? mark.left : arrow.left
			anchors.rightMargin: 4
			height: parent.height
			text: control.displayText !== "" ? control.displayText : control.placeholderText
			textFormat: Text.PlainText
			font.pixelSize: Theme.fontSize
			color: !control.enabled || control.displayText === "" ? Theme.disabledText : control.textColor
			verticalAlignment: Text.AlignVCenter
			elide: Text.ElideMiddle
		}
		SideMark {
			id: mark
			name: control.filterable ? control.displayText : ""
			anchors.right: arrow.left
			anchors.rightMargin: 4
			anchors.verticalCenter: parent.verticalCenter
		}
		Chevron {
			id: arrow
			anchors.right: parent.right
			anchors.verticalCenter: parent.verticalCenter
			rotation: 90
			ink: control.enabled ? Theme.windowText : Theme.disabledText
		}
	}

	HoverTip {
		hovered: control.hovered && !control.listed
		cut: caption.truncated
		whole: control.displayText
		toolTip: control.toolTip
	}

	onModelChanged: if (listed) list.item.refill()

	Loader {
		id: list
		active: false
		sourceComponent: ComboBoxList { box: control }
	}
}
