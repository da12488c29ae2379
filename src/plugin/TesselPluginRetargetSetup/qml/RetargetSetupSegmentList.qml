import QtQuick 2.15
import QtQuick.Controls 2.15
import Orlex.Controls 1.0
import Orlex.Selection 1.0
import Orlex.Theme 1.0
import TesselPluginRetargetSetup 1.0

// The segments of a subject. What is selected is the host's business: a row shows it, and the mouse and the keys ask
// for it. What is typed filters the rows.
FocusScope {
	id: segmentList

	property alias model: view.model
	readonly property alias count: view.count
	// What the lists are told apart by, for who cannot see them.
	property string title: ""
	// The one segment that is selected, -1 for none and for several.
	property int selectedIndex: -1
	// The row that the keys move from. The view's own current row is lost when the model is reset.
	property int keyIndex: -1
	// The row that a range begins at.
	property int anchorIndex: -1
	// Segments without a joint look different.
	property bool marksJoints: false
	// What a segment is mapped to, by its name: lines for the tool tip.
	property var mappingOf: name => ""

	// The right button was pressed on a row, or the menu key was: at a place of an item.
	signal menuRequested(Item item, real x, real y)

	readonly property var words: filter.text.toLowerCase().split(" ").filter(word => word !== "")

	Accessible.role: Accessible.List
	Accessible.name: title

	function nameOf(index) {
		return model.data(model.index(index, 0), RetargetSetupSegmentModel.Name)
	}
	function itemOf(index) {
		return model.data(model.index(index, 0), RetargetSetupSegmentModel.SelectionItem)
	}
	function shows(name) {
		const plain = name.toLowerCase()
		return words.every(word => plain.includes(word))
	}
	// So many shown rows away, as far as there are any.
	function shownFrom(index, by) {
		const step = by < 0 ? -1 : 1
		let found = index
		for (let at = index + step, left = Math.abs(by); at >= 0 && at < view.count && left > 0; at += step)
			if (shows(nameOf(at))) {
				found = at
				--left
			}
		return found
	}

	function moveTo(index) {
		keyIndex = index
		view.currentIndex = index
		view.positionViewAtIndex(index, ListView.Contain)
	}
	function takeKeyboard() {
		if (!filter.activeFocus)
			view.forceActiveFocus()
	}
	function selectItem(index, toggle) {
		takeKeyboard()
		if (index < 0 || index >= view.count)
			return
		if (toggle)
			SelectionManager.toggle(itemOf(index))
		else
			SelectionManager.clearAndSelect(itemOf(index))
		anchorIndex = index
		moveTo(index)
	}
	// All shown rows from the last one that was selected alone.
	function selectTo(index) {
		takeKeyboard()
		if (index < 0 || index >= view.count)
			return
		const from = anchorIndex >= 0 && anchorIndex < view.count ? anchorIndex : index
		SelectionManager.clearAndSelect(itemOf(from))
		for (let at = from; at !== index;) {
			at += index < from ? -1 : 1
			if (shows(nameOf(at)))
				SelectionManager.toggle(itemOf(at))
		}
		anchorIndex = from
		moveTo(index)
	}

	// Selects a segment alone, and shows it whatever the filter hides.
	function show(index) {
		if (index >= 0 && index < view.count && !shows(nameOf(index)))
			filter.clear()
		selectItem(index, false)
	}

	onSelectedIndexChanged: {
		if (selectedIndex === -1)
			return
		anchorIndex = selectedIndex
		keyIndex = selectedIndex
		view.positionViewAtIndex(selectedIndex, ListView.Contain)
	}

	Keys.onPressed: {
		const page = Math.max(1, Math.floor(view.height / Theme.itemHeight) - 1)
		const from = Math.min(keyIndex, view.count)
		const index = event.key === Qt.Key_Up ? shownFrom(from, -1) : event.key === Qt.Key_Down ? shownFrom(from, 1)
			: event.key === Qt.Key_PageUp ? shownFrom(from, -page) : event.key === Qt.Key_PageDown ? shownFrom(from, page)
			: event.key === Qt.Key_Home ? shownFrom(-1, 1) : event.key === Qt.Key_End ? shownFrom(view.count, -1) : null
		event.accepted = true
		if (index !== null)
			event.modifiers & Qt.ShiftModifier ? selectTo(index) : selectItem(index, false)
		else if (event.key === Qt.Key_Menu && view.currentItem)
			menuRequested(view.currentItem, 0, view.currentItem.height)
		else if (event.key === Qt.Key_Escape && filter.text !== "") {
			filter.clear()
			view.forceActiveFocus()
		}
		else if (event.text.trim() !== "" && event.key !== Qt.Key_Delete
				&& !(event.modifiers & (Qt.ControlModifier | Qt.AltModifier)) && !filter.activeFocus) {
			filter.forceActiveFocus()
			filter.insert(filter.length, event.text)
		}
		else
			event.accepted = false
	}

	OrlexTextField {
		id: filter
		objectName: segmentList.objectName + "Filter"
		anchors.left: parent.left
		anchors.right: parent.right
		placeholderText: "Filter"
		toolTip: "Shows the segments whose names hold every word. Typing in the list begins here, Escape ends it."
		Accessible.name: segmentList.title + ": filter"
		onAccepted: segmentList.selectItem(segmentList.shownFrom(-1, 1), false)
	}

	Rectangle {
		anchors.fill: view
		anchors.margins: -1
		color: Theme.dark
		border.color: segmentList.activeFocus ? Theme.active : Theme.mid
	}

	ListView {
		id: view

		objectName: segmentList.objectName + "View"
		anchors.fill: parent
		anchors.margins: 1
		anchors.topMargin: filter.height + 3
		clip: true
		focus: true
		boundsBehavior: Flickable.StopAtBounds
		highlightMoveDuration: 1
		highlightMoveVelocity: -1
		// The keys select, too.
		keyNavigationEnabled: false
		// The wheel and the bar scroll; a drag with the mouse is left alone.
		interactive: contentHeight > height

		ScrollBar.vertical: OrlexScrollBar {
			id: bar
			objectName: segmentList.objectName + "ScrollBar"
		}

		ScrollKeeper {
			view: view
		}

		delegate: Rectangle {
			id: row

			readonly property bool jointless: segmentList.marksJoints && !segmentList.model.HasJoint(index)
			readonly property string about: area.containsMouse ? [label.truncated ? name : "",
				segmentList.mappingOf(name), jointless ? "Has no joint: it does not turn by itself." : ""]
				.filter(line => line !== "").join("\n") : ""

			objectName: segmentList.objectName + "Row" + index
			width: ListView.view.width
			height: visible ? Theme.itemHeight : 0
			visible: segmentList.shows(name)
			color: watcher.selected ? Theme.light : watcher.preselected ? Theme.midlight : Theme.dark
			Accessible.role: Accessible.ListItem
			Accessible.name: name
			Accessible.description: jointless ? "no joint" : ""
			Accessible.selected: watcher.selected
			Accessible.onPressAction: segmentList.selectItem(index, false)

			SelectionWatcher {
				id: watcher
				item: selectionItem
			}

			OrlexLabel {
				id: label
				anchors.fill: parent
				anchors.leftMargin: Theme.spacing
				anchors.rightMargin: bar.width + (mark.visible ? mark.width + Theme.spacing : 0)
				text: name
				elide: Text.ElideRight
				font.italic: row.jointless
				color: watcher.selected ? Theme.bright : row.jointless ? Theme.disabledText : Theme.text
				ownToolTip: false
				Accessible.ignored: true
			}
			SideMark {
				id: mark
				name: label.text
				anchors.right: parent.right
				anchors.rightMargin: bar.width + 2
				anchors.verticalCenter: parent.verticalCenter
			}

			MouseArea {
				id: area
				anchors.fill: parent
				hoverEnabled: true
				acceptedButtons: Qt.LeftButton | Qt.RightButton
				onEntered: SelectionManager.preselect(selectionItem)
				onExited: SelectionManager.clearPreselection()
				onPressed: {
					view.forceActiveFocus()
					if (mouse.button === Qt.RightButton) {
						if (!watcher.selected)
							segmentList.selectItem(index, false)
						return segmentList.menuRequested(row, mouse.x, mouse.y)
					}
					if (mouse.modifiers & Qt.ShiftModifier)
						segmentList.selectTo(index)
					else
						segmentList.selectItem(index, mouse.modifiers & Qt.ControlModifier)
				}
			}
			Loader {
				active: row.about !== ""
				sourceComponent: OrlexToolTip {
					parent: row
					visible: true
					text: row.about
				}
			}
		}
	}
}
