import QtQuick 2.15
import QtQuick.Templates 2.15 as T
import Orlex.Selection 1.0
import Orlex.Theme 1.0

// Rows of a model in columns, under a header. A row that has a selection item shows whether it is selected, and selects
// it; the mouse pre-selects the row that it is on.
FocusScope {
	id: table

	property var model: null
	// Each {role, title, share}: the part of the width, and optionally "sides", true for names of left or right parts.
	property var columns: []
	property string selectionRole: "selectionItem"
	property alias currentIndex: list.currentIndex
	// The row that is selected, wherever that was done: it comes into view, and the keys go on from it. -1 for none and
	// for several.
	property int selectedIndex: -1
	readonly property alias count: list.count
	readonly property alias view: list
	// The right button was pressed on a row, which is selected by now, or the menu key was: at a place of an item.
	signal menuRequested(Item item, real x, real y)

	// What stands in the middle of a table without rows.
	property string emptyText: ""

	readonly property real shares: columns.reduce((sum, column) => sum + column.share, 0)
	readonly property real columnsWidth: list.width - scrollBar.width

	// Takes the keyboard first, so that a field that is being typed into commits to the row that it belongs to.
	function selectRow(index) {
		list.forceActiveFocus()
		if (index < 0 || index >= list.count)
			return
		list.currentIndex = index
		list.positionViewAtIndex(index, ListView.Contain)
		const row = list.itemAtIndex(index)
		if (row && row.selectionItem !== undefined)
			SelectionManager.clearAndSelect(row.selectionItem)
	}
	function cellText(value) {
		// Numbers in their C form, short: the whole one is in the tool tip of the cell.
		return value === undefined || value === null ? ""
			: typeof value === "number" ? String(Number(value.toPrecision(6))) : String(value)
	}
	function columnX(column) {
		let before = 0
		for (let i = 0; i < column; ++i)
			before += columns[i].share
		return shares > 0 ? Math.round(columnsWidth * before / shares) : 0
	}

	onSelectedIndexChanged: {
		if (selectedIndex < 0 || selectedIndex >= list.count)
			return
		list.currentIndex = selectedIndex
		list.positionViewAtIndex(selectedIndex, ListView.Contain)
	}

	implicitWidth: 300
	// Five rows under their header.
	implicitHeight: 6 * Theme.itemHeight
	activeFocusOnTab: true
	Accessible.role: Accessible.Table
	Accessible.name: objectName

	Rectangle {
		anchors.fill: parent
		color: Theme.dark
		border.width: 1
		border.color: list.activeFocus ? Theme.active : Theme.mid
	}

	Item {
		id: header
		x: 1
		y: 1
		width: parent.width - 2
		height: Theme.itemHeight

		Rectangle {
			anchors.fill: parent
			color: Theme.mid
		}
		Repeater {
			model: table.columns
			OrlexLabel {
				x: table.columnX(index) + 6
				width: table.columnX(index + 1) - table.columnX(index) - 12
				height: header.height
				text: modelData.title
				elide: Text.ElideRight
				font.bold: true
				Accessible.role: Accessible.ColumnHeader

				Rectangle {
					visible: index > 0
					x: -6
					y: 4
					width: 1
					height: parent.height - 8
					color: Theme.border
				}
			}
		}
	}

	ListView {
		id: list
		objectName: table.objectName + "Rows"
		anchors.fill: parent
		anchors.margins: 1
		anchors.topMargin: 1 + Theme.itemHeight
		clip: true
		focus: true
		model: table.model
		currentIndex: -1
		boundsBehavior: Flickable.StopAtBounds
		highlightMoveDuration: 1
		highlightMoveVelocity: -1
		keyNavigationEnabled: false
		T.ScrollBar.vertical: OrlexScrollBar {
			id: scrollBar
		}

		Keys.onPressed: {
			event.accepted = true
			if (event.key === Qt.Key_Up)
				table.selectRow(Math.max(0, currentIndex - 1))
			else if (event.key === Qt.Key_Down)
				table.selectRow(Math.min(count - 1, currentIndex + 1))
			else if (event.key === Qt.Key_Home)
				table.selectRow(0)
			else if (event.key === Qt.Key_End)
				table.selectRow(count - 1)
			else if (event.key === Qt.Key_Menu && currentItem)
				table.menuRequested(currentItem, 0, currentItem.height)
			else
				event.accepted = false
		}

		delegate: MouseArea {
			id: row

			readonly property var cells: model
			readonly property int rowIndex: index
			readonly property var selectionItem: model[table.selectionRole]

			objectName: table.objectName + "Row" + index
			width: list.width
			height: Theme.itemHeight
			hoverEnabled: true
			acceptedButtons: Qt.LeftButton | Qt.RightButton
			onEntered: if (selectionItem !== undefined) SelectionManager.preselect(selectionItem)
			onExited: SelectionManager.clearPreselection()
			onPressed: {
				table.selectRow(index)
				if (mouse.button === Qt.RightButton)
					table.menuRequested(row, mouse.x, mouse.y)
			}
			Accessible.role: Accessible.Row
			Accessible.name: table.columns.map(column => table.cellText(model[column.role])).join(", ")
			Accessible.selected: watcher.selected
			Accessible.onPressAction: table.selectRow(index)

			SelectionWatcher {
				id: watcher
				item: row.selectionItem
			}
			Rectangle {
				anchors.fill: parent
				color: watcher.selected ? Theme.light : watcher.preselected ? Theme.midlight : Theme.dark
			}
			Repeater {
				model: table.columns
				Item {
					id: cell
					readonly property var value: row.cells[modelData.role]
					x: table.columnX(index) + 6
					width: table.columnX(index + 1) - table.columnX(index) - 12
					height: row.height

					SideMark {
						id: mark
						name: modelData.sides ? table.cellText(cell.value) : ""
						anchors.right: parent.right
						anchors.verticalCenter: parent.verticalCenter
					}
					OrlexLabel {
						objectName: row.objectName + modelData.role
						width: parent.width - (mark.visible ? mark.width + 3 : 0)
						height: parent.height
						text: table.cellText(cell.value)
						toolTip: typeof cell.value === "number" && String(cell.value) !== text ? String(cell.value) : ""
						color: watcher.selected ? Theme.bright : Theme.text
					}
				}
			}
		}
	}
	ScrollKeeper {
		view: list
	}
	Text {
		visible: list.count === 0
		anchors.fill: list
		anchors.margins: Theme.margin
		text: table.emptyText
		textFormat: Text.PlainText
		wrapMode: Text.Wrap
		font.pixelSize: Theme.fontSize
		color: Theme.disabledText
		horizontalAlignment: Text.AlignHCenter
		verticalAlignment: Text.AlignVCenter
	}
}
