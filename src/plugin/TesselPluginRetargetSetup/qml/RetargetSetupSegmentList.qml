import QtQuick 2.15
import QtQuick.Controls 2.15
import Orlex.Controls 1.0
import Orlex.Selection 1.0
import Orlex.Theme 1.0
import TesselPluginRetargetSetup 1.0

// The segments of a subject. What is selected is the host's business: a row shows it, and the mouse and the keys ask
// for it.
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

	Accessible.role: Accessible.List
	Accessible.name: title

	function selectItem(index, toggle) {
		forceActiveFocus()
		if (index < 0 || index >= view.count)
			return
		const item = model.data(model.index(index, 0), RetargetSetupSegmentModel.SelectionItem)
		if (toggle)
			SelectionManager.toggle(item)
		else
			SelectionManager.clearAndSelect(item)
		keyIndex = index
		view.currentIndex = index
	}

	onSelectedIndexChanged: {
		if (selectedIndex === -1)
			return
		keyIndex = selectedIndex
		view.positionViewAtIndex(selectedIndex, ListView.Contain)
	}

	Keys.onUpPressed: selectItem(Math.min(keyIndex, view.count) - 1, false)
	Keys.onDownPressed: selectItem(keyIndex + 1, false)
	Keys.onPressed: {
		if (event.key === Qt.Key_Home)
			selectItem(0, false)
		else if (event.key === Qt.Key_End)
			selectItem(view.count - 1, false)
		else
			return
		event.accepted = true
	}

	Rectangle {
		anchors.fill: parent
		color: Theme.dark
		border.color: segmentList.activeFocus ? Theme.active : Theme.mid
	}

	ListView {
		id: view

		objectName: segmentList.objectName + "View"
		anchors.fill: parent
		anchors.margins: 1
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

			objectName: segmentList.objectName + "Row" + index
			width: ListView.view.width
			height: Theme.itemHeight
			color: watcher.selected ? Theme.light : watcher.preselected ? Theme.midlight : Theme.dark
			Accessible.role: Accessible.ListItem
			Accessible.name: name
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
				color: watcher.selected ? Theme.bright : Theme.text
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
				onEntered: SelectionManager.preselect(selectionItem)
				onExited: SelectionManager.clearPreselection()
				onPressed: segmentList.selectItem(index, mouse.modifiers & Qt.ControlModifier)
			}
			OrlexToolTip {
				visible: area.containsMouse && label.truncated
				text: name
			}
		}
	}
}
