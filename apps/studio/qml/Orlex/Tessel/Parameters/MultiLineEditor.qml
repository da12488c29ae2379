import QtQuick 2.15
import Orlex.Controls 1.0
import Orlex.Theme 1.0

// A text of several lines. Leaving it and Ctrl+Enter commit, Escape brings back what the parameter holds.
Item {
	id: editor

	property var row
	readonly property string valueText: row ? row.valueText : ""
	property bool edited: false

	function restore() {
		edited = false
		// As in a field of one line.
		if (field.area.canUndo)
			field.text = ""
		field.text = Qt.binding(() => editor.valueText)
	}
	function commit() {
		if (!edited)
			return
		edited = false
		if (row.commit(field.text))
			restore()
	}

	implicitHeight: field.implicitHeight
	onValueTextChanged: restore()
	Component.onCompleted: restore()

	Connections {
		target: editor.row ? editor.row : null
		function onRestored() {
			editor.restore()
		}
	}

	OrlexTextArea {
		id: field
		width: parent.width
		error: editor.row ? editor.row.error : ""
		area.objectName: editor.row ? editor.row.name : ""
		Accessible.name: editor.row ? editor.row.label : ""
		onAccepted: editor.commit()

		Connections {
			target: field.area
			function onTextChanged() {
				if (field.area.activeFocus && field.text !== editor.valueText) {
					editor.edited = true
					editor.row.error = ""
				}
			}
			function onActiveFocusChanged() {
				if (!field.area.activeFocus)
					editor.commit()
			}
		}
		Keys.onPressed: {
			if (event.key === Qt.Key_Escape && (editor.edited || error !== "")) {
				event.accepted = true
				editor.row.error = ""
				editor.restore()
			}
		}
	}
}
