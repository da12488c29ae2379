import QtQuick 2.15
import Orlex.Controls 1.0
import Orlex.Theme 1.0

// A value as one line of text, with a button for a parameter that names files. Enter and leaving the field commit,
// Escape brings back what the parameter holds.
Item {
	id: editor

	property var row
	readonly property string valueText: row ? row.valueText : ""
	property bool edited: false
	// Six digits tell enough until the field is typed into.
	readonly property string shortText: {
		const rounded = row && row.numeric && valueText !== "" ? Number(Number(valueText).toPrecision(6)) : NaN
		return isNaN(rounded) || String(rounded).length >= valueText.length ? valueText : String(rounded)
	}

	function restore() {
		edited = false
		// Ctrl+Z undoes what is being typed, and no longer what was taken.
		if (field.canUndo)
			field.text = ""
		field.text = Qt.binding(() => field.activeFocus ? valueText : shortText)
		showEnd()
	}
	function commit() {
		if (!edited)
			return
		edited = false
		if (row.commit(field.text))
			restore()
	}

	// The start of a long text tells more than its end; of a path the end.
	function showEnd() {
		if (!field.activeFocus)
			field.cursorPosition = fileButton.active ? field.length : 0
	}

	implicitHeight: Theme.controlHeight
	onValueTextChanged: restore()
	Component.onCompleted: restore()

	Connections {
		target: editor.row ? editor.row : null
		function onRestored() {
			editor.restore()
		}
	}

	OrlexTextField {
		id: field
		objectName: editor.row ? editor.row.name : ""
		width: parent.width - (fileButton.active ? fileButton.width + 4 : 0)
		height: Theme.controlHeight
		error: editor.row ? editor.row.error : ""
		placeholderText: editor.row && !editor.row.parameter.hasValue ? editor.row.defaultText : ""
		Accessible.name: editor.row ? editor.row.label : ""
		toolTip: editor.shortText !== editor.valueText ? editor.valueText : ""
		onTextEdited: {
			editor.edited = true
			// What is typed stays until it is taken, wherever the keyboard goes.
			text = text
			editor.row.error = ""
		}
		onEditingFinished: {
			editor.commit()
			editor.showEnd()
		}
		Keys.onEscapePressed: {
			event.accepted = editor.edited || error !== ""
			editor.row.error = ""
			editor.restore()
		}
	}
	Loader {
		id: fileButton
		active: !!editor.row && editor.row.namesFiles
		anchors.right: parent.right
		sourceComponent: FileButton { row: editor.row }
	}
}
