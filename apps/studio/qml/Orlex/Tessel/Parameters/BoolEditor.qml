import QtQuick 2.15
import Orlex.Controls 1.0
import Orlex.Theme 1.0

// Yes or no: a check box, or a button that stays down where the parameter is an option.
Item {
	id: editor

	property var row
	readonly property bool option: !!row && row.parameter.presentationHint === row.checkableOption
	readonly property bool on: !!row && !!row.parameter.value

	function toggle(control) {
		row.commit(control.checked ? "true" : "false")
		control.checked = Qt.binding(() => editor.on)
	}

	implicitHeight: Theme.controlHeight

	OrlexCheckBox {
		objectName: editor.row && visible ? editor.row.name : ""
		visible: !editor.option
		Accessible.name: editor.row ? editor.row.label : ""
		Component.onCompleted: checked = Qt.binding(() => editor.on)
		onToggled: editor.toggle(this)
	}
	OrlexButton {
		objectName: editor.row && visible ? editor.row.name : ""
		visible: editor.option
		checkable: true
		text: checked ? "On" : "Off"
		implicitWidth: 60
		Accessible.name: editor.row ? editor.row.label : ""
		Component.onCompleted: checked = Qt.binding(() => editor.on)
		onToggled: editor.toggle(this)
	}
}
