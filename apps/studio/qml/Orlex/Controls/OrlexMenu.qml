import QtQuick 2.15
import QtQml.Models 2.15
import QtQuick.Templates 2.15 as T
import Orlex.Theme 1.0

// A menu of entries, each {text, keys, reason, act}: what it is called, which keys do the same, why it cannot be done
// now (empty if it can), and what it does.
T.Menu {
	id: menu

	property var entries: []

	// An entry was chosen that cannot be done now.
	signal refused(string reason)

	// At a place of an item.
	function show(item, x, y, list) {
		entries = list
		popup(item, x, y)
	}

	implicitWidth: contentItem.widest + leftPadding + rightPadding
	implicitHeight: contentItem.contentHeight + topPadding + bottomPadding
	margins: 4
	padding: 2

	contentItem: ListView {
		readonly property real widest: {
			let most = 120
			for (let i = 0; i < menu.count; ++i)
				most = Math.max(most, menu.itemAt(i).implicitWidth)
			return most
		}
		implicitHeight: contentHeight
		model: menu.contentModel
		interactive: false
		currentIndex: menu.currentIndex
	}
	background: Rectangle {
		color: Theme.mid
		border.color: Theme.border
		radius: Theme.radius
	}

	Instantiator {
		model: menu.entries
		onObjectAdded: menu.insertItem(index, object)
		onObjectRemoved: menu.removeItem(object)

		T.MenuItem {
			id: item

			readonly property string reason: modelData.reason || ""
			readonly property bool possible: reason === ""

			objectName: "menu" + modelData.text.replace(/[^A-Za-z]/g, "")
			text: modelData.text
			implicitWidth: Math.ceil(caption.implicitWidth + keys.implicitWidth) + leftPadding + rightPadding + 24
			implicitHeight: Theme.controlHeight
			leftPadding: 8
			rightPadding: 8
			font.pixelSize: Theme.fontSize
			hoverEnabled: true
			Accessible.role: Accessible.MenuItem
			Accessible.name: text
			Accessible.description: reason
			onTriggered: possible ? menu.entries[index].act() : menu.refused(reason)

			contentItem: Item {
				Text {
					id: caption
					anchors.verticalCenter: parent.verticalCenter
					text: item.text
					textFormat: Text.PlainText
					font: item.font
					color: item.possible ? Theme.text : Theme.disabledText
				}
				Text {
					id: keys
					anchors {
						right: parent.right
						verticalCenter: parent.verticalCenter
					}
					text: modelData.keys || ""
					textFormat: Text.PlainText
					font: item.font
					color: Theme.disabledText
				}
			}
			background: Rectangle {
				color: item.highlighted ? Theme.midlight : "transparent"
				radius: Theme.radius
			}
			OrlexToolTip {
				visible: item.highlighted && !item.possible
				text: item.reason
			}
		}
	}
}
