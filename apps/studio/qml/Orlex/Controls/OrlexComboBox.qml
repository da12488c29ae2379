import QtQuick 2.15
import QtQuick.Templates 2.15 as T
import QtQuick.Window 2.15
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
	readonly property alias popup: popup

	// The operator picked an entry; currentIndex is it already.
	signal activated(int index)

	function pick(index) {
		popup.close()
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
		filterField.text = filterable ? filter : ""
		popup.refill()
		popup.open()
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
				list.currentIndex = found
			}
		}
		else
			event.accepted = false
	}

	FieldFrame {
		anchors.fill: parent
		focused: control.activeFocus || popup.visible
		hovered: control.hovered
		invalid: control.invalid
		color: !control.enabled ? Theme.window : popup.visible ? Theme.base : Theme.button
	}

	MouseArea {
		id: mouse
		anchors.fill: parent
		anchors.leftMargin: 6
		anchors.rightMargin: 4
		hoverEnabled: true
		onPressed: {
			control.forceActiveFocus(Qt.MouseFocusReason)
			if (popup.visible)
				popup.close()
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
		hovered: control.hovered && !popup.visible
		cut: caption.truncated
		whole: control.displayText
		toolTip: control.toolTip
	}

	onModelChanged: if (popup.visible) popup.refill()

	T.Popup {
		id: popup

		// Indices of the entries that the filter leaves.
		property var rows: []
		readonly property real wanted: rowsHeight + (control.filterable ? Theme.controlHeight + 24 : 0) + 2 * padding
		readonly property real rowsHeight: Math.max(1, Math.min(control.count, 18)) * Theme.itemHeight

		function refill() {
			const words = filterField.text.toLowerCase().split(" ").filter(word => word !== "")
			const before = rows.length > 0 && list.currentIndex >= 0 ? rows[list.currentIndex] : control.currentIndex
			const found = []
			// "count" may not have followed the model yet.
			for (let i = 0; control.model && i < control.model.length; ++i) {
				const entry = words.length > 0 ? control.model[i].toLowerCase() : ""
				if (words.every(word => entry.includes(word)))
					found.push(i)
			}
			rows = found
			// A name typed in full is meant, though longer ones that hold it may come first.
			const typed = words.length > 0 ? filterField.text.trim().toLowerCase() : null
			const whole = found.findIndex(i => control.model[i].trim().toLowerCase() === typed)
			list.currentIndex = whole >= 0 ? whole : found.length > 0 ? Math.max(0, found.indexOf(before)) : -1
			list.positionViewAtIndex(list.currentIndex, ListView.Contain)
		}
		// Wide enough for the longest entry. Below the box, or above it where there is more room.
		function place() {
			let longest = ""
			for (let i = 0; i < control.count; ++i)
				if (control.model[i].length > longest.length)
					longest = control.model[i]
			width = Math.min(control.Window.width - 2 * margins, Math.max(control.width, control.filterable ? 220 : 0,
				Math.ceil(metrics.advanceWidth(longest.trim())) + 7 * (longest.length - longest.trim().length) + 50))
			const box = control.mapToItem(null, 0, 0)
			const room = control.Window.height
			const below = room - box.y - control.height - 6
			const above = box.y - 6
			const up = below < wanted && above > below
			height = Math.min(wanted, up ? above : below)
			y = up ? -height - 2 : control.height + 2
		}

		readonly property FontMetrics metrics: FontMetrics {
			font.pixelSize: Theme.fontSize
		}

		objectName: control.objectName + "Popup"
		margins: 2
		padding: 1
		focus: true
		closePolicy: T.Popup.CloseOnEscape | T.Popup.CloseOnPressOutsideParent
		onAboutToShow: place()
		onOpened: {
			list.currentIndex = rows.length > 0 ? Math.max(0, rows.indexOf(control.currentIndex)) : -1
			if (control.filterable)
				filterField.forceActiveFocus()
			else
				list.forceActiveFocus()
			list.positionViewAtIndex(list.currentIndex, ListView.Center)
		}
		// With the reason of popups nested focus scopes do not get it back.
		onClosed: control.forceActiveFocus()

		background: Rectangle {
			color: Theme.dark
			border.color: Theme.disabledText
			radius: Theme.radius
		}

		contentItem: FocusScope {
			Keys.onPressed: {
				event.accepted = true
				const page = Math.max(1, Math.floor(list.height / Theme.itemHeight) - 1)
				const move = by => list.currentIndex = Math.max(0, Math.min(list.count - 1, list.currentIndex + by))
				if (event.key === Qt.Key_Up)
					move(-1)
				else if (event.key === Qt.Key_Down)
					move(1)
				else if (event.key === Qt.Key_PageUp)
					move(-page)
				else if (event.key === Qt.Key_PageDown)
					move(page)
				else if (event.key === Qt.Key_Home)
					move(-list.count)
				else if (event.key === Qt.Key_End)
					move(list.count)
				else if (event.key === Qt.Key_Return || event.key === Qt.Key_Enter
						|| event.key === Qt.Key_Space && !control.filterable)
					control.pick(list.currentIndex >= 0 ? popup.rows[list.currentIndex] : -1)
				else if (event.key === Qt.Key_Tab || event.key === Qt.Key_Backtab) {
					popup.close()
					control.nextItemInFocusChain(event.key === Qt.Key_Tab).forceActiveFocus(Qt.TabFocusReason)
				}
				else if (!control.filterable && control.typesText(event)) {
					const found = control.findFrom(list.currentIndex, event.text)
					if (found >= 0)
						list.currentIndex = found
				}
				else
					event.accepted = false
			}

			OrlexTextField {
				id: filterField
				objectName: control.objectName + "Filter"
				visible: control.filterable
				enabled: visible
				focus: visible
				x: 3
				y: 3
				width: parent.width - 6
				placeholderText: "Type to filter"
				onTextEdited: popup.refill()
			}

			ListView {
				id: list
				objectName: control.objectName + "List"
				anchors.fill: parent
				anchors.topMargin: control.filterable ? filterField.height + 6 : 0
				anchors.bottomMargin: control.filterable ? 18 : 0
				clip: true
				focus: !control.filterable
				model: popup.visible ? popup.rows : []
				boundsBehavior: Flickable.StopAtBounds
				highlightMoveDuration: 0
				keyNavigationEnabled: false
				T.ScrollBar.vertical: OrlexScrollBar {}

				delegate: MouseArea {
					id: entry

					readonly property string text: modelData < control.count ? control.model[modelData] : ""
					readonly property string name: text.trim()
					readonly property int depth: text.length - text.replace(/^ +/, "").length

					width: list.width
					height: Theme.itemHeight
					hoverEnabled: true
					// Not on entering: the list also moves under a mouse that stands still.
					onPositionChanged: list.currentIndex = index
					onClicked: control.pick(modelData)
					Accessible.role: Accessible.ListItem
					Accessible.name: name

					Rectangle {
						anchors.fill: parent
						color: modelData === control.currentIndex ? Theme.light
							: entry.ListView.isCurrentItem ? Theme.midlight : "transparent"
						border.width: entry.ListView.isCurrentItem ? 1 : 0
						border.color: Theme.active
					}
					OrlexLabel {
						x: 6 + Math.min(7 * entry.depth, 0.4 * parent.width)
						width: parent.width - x - 12 - entryMark.width - 4
						height: parent.height
						text: entry.name
						color: modelData === control.currentIndex ? Theme.bright : Theme.text
					}
					SideMark {
						id: entryMark
						name: control.filterable ? entry.name : ""
						anchors.right: parent.right
						anchors.rightMargin: 14
						anchors.verticalCenter: parent.verticalCenter
					}
				}
			}
			Text {
				visible: list.count === 0
				anchors.fill: list
				text: control.count === 0 ? "Nothing to choose from" : "Nothing holds \"" + filterField.text.trim() + "\""
				textFormat: Text.PlainText
				elide: Text.ElideRight
				font.pixelSize: Theme.fontSize
				color: Theme.disabledText
				horizontalAlignment: Text.AlignHCenter
				verticalAlignment: Text.AlignVCenter
			}
			Text {
				visible: control.filterable
				anchors.bottom: parent.bottom
				x: 6
				height: 18
				text: list.count === control.count ? control.count + " entries" : list.count + " of " + control.count
				font.pixelSize: Theme.fontSize - 2
				color: Theme.disabledText
				verticalAlignment: Text.AlignVCenter
			}
		}
	}
}
