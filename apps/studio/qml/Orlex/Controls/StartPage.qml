import QtQuick 2.15
import Orlex.Theme 1.0

// Stands over an empty view, and offers what a job begins with.
Rectangle {
	id: page

	// Of the buttons; the last one is for what the lists offer.
	property var texts: []

	signal chosen(int index)

	objectName: "startPage"
	anchors.centerIn: parent
	// Below what the corner of the view holds.
	anchors.verticalCenterOffset: 40
	width: Math.min(360, parent ? parent.width - 2 * Theme.margin : 0)
	height: column.height + 4 * Theme.margin
	color: Theme.window
	border.color: Theme.border
	radius: Theme.radius
	Accessible.role: Accessible.Pane
	Accessible.name: "Begin"

	Column {
		id: column
		x: 2 * Theme.margin
		y: 2 * Theme.margin
		width: page.width - 2 * x
		spacing: Theme.spacing

		Repeater {
			model: page.texts
			Column {
				readonly property bool last: index === page.texts.length - 1
				width: column.width
				spacing: Theme.spacing

				OrlexLabel {
					visible: index === 0 || parent.last
					width: parent.width
					wrapMode: Text.Wrap
					elide: Text.ElideNone
					text: index === 0
						? "Begin with a performer and a character, or with a retarget subject. Files can be dropped here, too."
						: "The lists on the left offer the files of the folders in the preferences."
				}
				OrlexButton {
					objectName: "start" + index
					width: parent.width
					text: modelData
					onClicked: page.chosen(index)
				}
			}
		}
	}
}
