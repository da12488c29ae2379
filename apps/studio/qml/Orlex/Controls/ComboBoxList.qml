import QtQuick 2.15
import QtQuick.Templates 2.15 as T
import QtQuick.Window 2.15
import Orlex.Theme 1.0

// The list of an OrlexComboBox, with a field to filter it.
T.Popup {
	id: popup

	property Item box
	// Indices of the entries that the filter leaves.
	property var rows: []
	readonly property real wanted: rowsHeight + (box.filterable ? Theme.controlHeight + 24 : 0) + 2 * padding
	readonly property real rowsHeight: Math.max(1, Math.min(box.count, 18)) * Theme.itemHeight

	function begin(filter) {
		filterField.text = box.filterable ? filter : ""
		refill()
		open()
	}
	function goTo(index) {
		list.currentIndex = index
	}
	function refill() {
		const words = filterField.text.toLowerCase().split(" ").filter(word => word !== "")
		const before = rows.length > 0 && list.currentIndex >= 0 ? rows[list.currentIndex] : box.currentIndex
		const found = []
		// "count" may not have followed the model yet.
		for (let i = 0; box.model && i < box.model.length; ++i) {
			const entry = words.length > 0 ? box.model[i].toLowerCase() : ""
			if (words.every(word => entry.includes(word)))
				found.push(i)
		}
		rows = found
		// A name typed in full is meant, though longer ones that hold it may come first.
		const typed = words.length > 0 ? filterField.text.trim().toLowerCase() : null
		const whole = found.findIndex(i => box.model[i].trim().toLowerCase() === typed)
		list.currentIndex = whole >= 0 ? whole : found.length > 0 ? Math.max(0, found.indexOf(before)) : -1
		list.positionViewAtIndex(list.currentIndex, ListView.Contain)
	}
	// Wide enough for the longest entry. Below the box, or above it where there is more room.
	function place() {
		let longest = ""
		for (let i = 0; i < box.count; ++i)
			if (box.model[i].length > longest.length)
				longest = box.model[i]
		width = Math.min(box.Window.width - 2 * margins, Math.max(box.width, box.filterable ? 220 : 0,
			Math.ceil(metrics.advanceWidth(longest.trim())) + 7 * (longest.length - longest.trim().length) + 50))
		const corner = box.mapToItem(null, 0, 0)
		const room = box.Window.height
		const below = room - corner.y - box.height - 6
		const above = corner.y - 6
		const up = below < wanted && above > below
		height = Math.min(wanted, up ? above : below)
		y = up ? -height - 2 : box.height + 2
	}

	readonly property FontMetrics metrics: FontMetrics {
		font.pixelSize: Theme.fontSize
	}

	parent: box
	objectName: box.objectName + "Popup"
	margins: 2
	padding: 1
	focus: true
	closePolicy: T.Popup.CloseOnEscape | T.Popup.CloseOnPressOutsideParent
	onAboutToShow: place()
	onOpened: {
		list.currentIndex = rows.length > 0 ? Math.max(0, rows.indexOf(box.currentIndex)) : -1
		if (box.filterable)
			filterField.forceActiveFocus()
		else
			list.forceActiveFocus()
		list.positionViewAtIndex(list.currentIndex, ListView.Center)
	}
	// With the reason of popups nested focus scopes do not get it back.
	onClosed: box.forceActiveFocus()

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
					|| event.key === Qt.Key_Space && !box.filterable)
				box.pick(list.currentIndex >= 0 ? popup.rows[list.currentIndex] : -1)
			else if (event.key === Qt.Key_Tab || event.key === Qt.Key_Backtab) {
				popup.close()
				box.nextItemInFocusChain(event.key === Qt.Key_Tab).forceActiveFocus(Qt.TabFocusReason)
			}
			else if (!box.filterable && box.typesText(event)) {
				const found = box.findFrom(list.currentIndex, event.text)
				if (found >= 0)
					list.currentIndex = found
			}
			else
				event.accepted = false
		}

		OrlexTextField {
			id: filterField
			objectName: box.objectName + "Filter"
			visible: box.filterable
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
			objectName: box.objectName + "List"
			anchors.fill: parent
			anchors.topMargin: box.filterable ? filterField.height + 6 : 0
			anchors.bottomMargin: box.filterable ? 18 : 0
			clip: true
			focus: !box.filterable
			model: popup.visible ? popup.rows : []
			boundsBehavior: Flickable.StopAtBounds
			highlightMoveDuration: 0
			keyNavigationEnabled: false
			T.ScrollBar.vertical: OrlexScrollBar {}

			delegate: MouseArea {
				id: entry

				readonly property string text: modelData < box.count ? box.model[modelData] : ""
				readonly property string name: text.trim()
				readonly property int depth: text.length - text.replace(/^ +/, "").length

				width: list.width
				height: Theme.itemHeight
				hoverEnabled: true
				// Not on entering: the list also moves under a mouse that stands still.
				onPositionChanged: list.currentIndex = index
				onClicked: box.pick(modelData)
				Accessible.role: Accessible.ListItem
				Accessible.name: name

				Rectangle {
					anchors.fill: parent
					color: modelData === box.currentIndex ? Theme.light
						: entry.ListView.isCurrentItem ? Theme.midlight : "transparent"
					border.width: entry.ListView.isCurrentItem ? 1 : 0
					border.color: Theme.active
				}
				OrlexLabel {
					x: 6 + Math.min(7 * entry.depth, 0.4 * parent.width)
					width: parent.width - x - 12 - entryMark.width - 4
					height: parent.height
					text: entry.name
					color: modelData === box.currentIndex ? Theme.bright : Theme.text
				}
				SideMark {
					id: entryMark
					name: box.filterable ? entry.name : ""
					anchors.right: parent.right
					anchors.rightMargin: 14
					anchors.verticalCenter: parent.verticalCenter
				}
			}
		}
		Text {
			visible: list.count === 0
			anchors.fill: list
			text: box.count === 0 ? "Nothing to choose from" : "Nothing holds \"" + filterField.text.trim() + "\""
			textFormat: Text.PlainText
			elide: Text.ElideRight
			font.pixelSize: Theme.fontSize
			color: Theme.disabledText
			horizontalAlignment: Text.AlignHCenter
			verticalAlignment: Text.AlignVCenter
		}
		Text {
			visible: box.filterable
			anchors.bottom: parent.bottom
			x: 6
			height: 18
			text: list.count === box.count ? box.count + " entries" : list.count + " of " + box.count
			font.pixelSize: Theme.fontSize - 2
			color: Theme.disabledText
			verticalAlignment: Text.AlignVCenter
		}
	}
}
