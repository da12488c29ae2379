import QtQuick 2.15
import Orlex.Controls 1.0
import Orlex.Theme 1.0
import TesselQML 1.0

// One of the permitted values. A value that is none of them (a file may bring one) is shown as it is, in the colour of
// a warning.
Item {
	id: editor

	property var row
	// No value is the entry of the empty value, where there is one: "(None)".
	readonly property int chosen: !row ? -1 : row.parameter.currentEnumIndex >= 0 ? row.parameter.currentEnumIndex
		: row.valueText === "" && row.parameter.enumTexts ? row.parameter.enumTexts.indexOf("") : -1
	readonly property bool foreign: chosen < 0 && !!row && row.valueText !== ""

	function follow() {
		box.currentIndex = Qt.binding(() => chosen)
	}

	implicitHeight: Theme.controlHeight
	Component.onCompleted: follow()

	OrlexComboBox {
		id: box
		objectName: editor.row ? editor.row.name : ""
		width: parent.width - (fileButton.active ? fileButton.width + 4 : 0)
		model: editor.row ? editor.row.enumNames : []
		// A pick may load a file.
		steps: false
		displayText: currentIndex >= 0 ? currentText : editor.foreign ? Tessel.visible(editor.row.valueText) : ""
		placeholderText: count > 0 ? "Not set" : "Nothing to choose from"
		textColor: editor.foreign ? Theme.warning : Theme.text
		toolTip: editor.foreign ? "This value is not in the list" : count === 0 && editor.row && editor.row.hint.none || ""
		invalid: !!editor.row && editor.row.error !== ""
		Accessible.name: editor.row ? editor.row.label : ""
		onActivated: {
			editor.row.error = editor.row.groupModel.setEnumIndex(editor.row.parameterIndex, index) ? ""
				: "This value cannot be set"
			editor.follow()
		}
		Keys.onEscapePressed: {
			event.accepted = invalid
			editor.row.error = ""
		}
	}
	Loader {
		id: fileButton
		active: !!editor.row && editor.row.namesFiles
		anchors.right: parent.right
		sourceComponent: FileButton { row: editor.row }
	}
}
