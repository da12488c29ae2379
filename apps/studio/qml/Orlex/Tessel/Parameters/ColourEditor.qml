import QtQuick 2.15
import QtQuick.Dialogs 1.3
import Orlex.Controls 1.0
import Orlex.Theme 1.0

// A colour as a swatch, which opens a dialog, and as text.
Item {
	id: editor

	property var row
	readonly property string valueText: row ? row.valueText : ""
	readonly property bool known: /^#([0-9a-f]{3}|[0-9a-f]{6}|[0-9a-f]{8})$/i.test(valueText)

	implicitHeight: Theme.controlHeight
	onRowChanged: field.row = row

	OrlexButton {
		id: swatch
		objectName: editor.row ? editor.row.name + "Swatch" : ""
		width: 32
		Accessible.name: editor.row ? editor.row.label + ": choose a colour" : ""
		toolTip: "Choose a colour"
		onClicked: {
			dialog.active = true
			if (editor.known)
				dialog.item.color = editor.valueText
			dialog.item.open()
		}

		Rectangle {
			anchors.fill: parent
			anchors.margins: 3
			radius: 2
			visible: editor.known
			color: editor.known ? editor.valueText : "transparent"
		}
	}
	TextEditor {
		id: field
		x: swatch.width + 4
		width: parent.width - x
	}
	Loader {
		id: dialog
		active: false
		sourceComponent: ColorDialog {
			title: editor.row.label
			showAlphaChannel: editor.valueText.length === 9
			onAccepted: editor.row.commit(String(color))
		}
	}
}
