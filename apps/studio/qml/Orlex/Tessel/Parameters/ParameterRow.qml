import QtQuick 2.15
import Orlex.Controls 1.0
import Orlex.Theme 1.0

// One parameter: its label, the editor for its kind, why the last input was refused. What only some parameters have is
// made for those.
Item {
	id: row

	// The row's roles, its place, and the model that takes what is typed.
	property var parameter
	property int parameterIndex: -1
	property var groupModel
	property int labelWidth: 100
	// {unit, check, none}, as in ParameterView.
	property var hint: ({})

	property int generation: 0

	property string error: ""
	property string refusedText: ""
	readonly property string name: parameter.name
	readonly property string label: parameter.display || parameter.name
	readonly property string toolTip: [parameter.description || "", allowed].filter(line => line !== "").join("\n")
	// What the limits let through, as a sentence.
	readonly property string allowed: isNumber(parameter.minimum) && isNumber(parameter.maximum)
		? "Allowed: " + parameter.minimum + " to " + parameter.maximum + "."
		: isNumber(parameter.minimum) ? "Allowed: " + parameter.minimum + " or more."
		: isNumber(parameter.maximum) ? "Allowed: " + parameter.maximum + " or less." : ""
	readonly property string unit: hint.unit || ""
	// Shown in a few digits where it is not typed into.
	readonly property bool numeric: parameter.type === "double" || unit !== ""
	readonly property string valueText: parameter.valueText === undefined ? "" : parameter.valueText
	readonly property string defaultText: parameter.defaultText || ""
	readonly property var enumNames: parameter.enumNames || []
	readonly property bool enumerated: parameter.enumerated === undefined ? enumNames.length > 0 : parameter.enumerated
	readonly property bool bounded: isNumber(parameter.minimum) && isNumber(parameter.maximum)
		&& parameter.maximum > parameter.minimum
	// Can be switched off, so that it has no value; one with a default always has a value.
	readonly property bool checkable: defaultText === "" && (parameter.presentationHint === checkableSlider
		|| parameter.presentationHint === checkableOption && parameter.type !== "bool")
	// Switched on, and waiting for its first value.
	property bool wanted: false
	readonly property bool editable: !checkable || !!parameter.hasValue || wanted

	// Presentation hints and kinds of file access, as the store numbers them.
	readonly property int slider: 1
	readonly property int multiLine: 2
	readonly property int checkableOption: 3
	readonly property int checkableSlider: 4
	readonly property int colour: 5
	readonly property int noFile: 0
	readonly property bool namesFiles: (parameter.fileAccess || noFile) !== noFile

	function isNumber(value) {
		return typeof value === "number" && isFinite(value)
	}
	// Hands a text to the parameter: true if it was taken. Otherwise the reason stands in "error" and the parameter
	// keeps what it had.
	function commit(text) {
		error = hint.check ? hint.check(text) : ""
		if (error === "") {
			error = groupModel.setValueText(parameterIndex, text)
			if (error !== "" && allowed !== "")
				error += ". " + allowed
		}
		refusedText = error !== "" ? text : ""
		return error === ""
	}
	function editorUrl() {
		const hint = parameter.presentationHint
		if (enumerated)
			return "EnumerationEditor.qml"
		if (parameter.type === "bool")
			return "BoolEditor.qml"
		if ((hint === slider || hint === checkableSlider) && bounded && parameter.type !== "text")
			return "SliderEditor.qml"
		if (hint === multiLine && parameter.type === "text")
			return "MultiLineEditor.qml"
		if (hint === colour)
			return "ColourEditor.qml"
		return "TextEditor.qml"
	}

	// The editors show what the parameter holds.
	signal restored()

	onGenerationChanged: {
		if (error !== "")
			console.warn(label + ": \"" + refusedText + "\" was not taken. " + error)
		error = ""
		restored()
	}

	objectName: name + "Row"
	implicitHeight: Math.max(Theme.controlHeight, editor.y + editor.height)
		+ (reason.visible ? reason.implicitHeight + 2 : 0)
	// What was refused belongs to the value that it was typed over.
	onValueTextChanged: error = ""

	Loader {
		id: switcher
		active: row.checkable
		sourceComponent: OrlexCheckBox {
			objectName: row.name + "Switch"
			width: implicitWidth + 4
			Accessible.name: row.label + " is set"
			Component.onCompleted: checked = Qt.binding(() => row.editable)
			onToggled: {
				row.error = ""
				row.wanted = checked
				if (!checked)
					row.groupModel.resetToDefault(row.parameterIndex)
				else if (row.enumerated)
					row.groupModel.setEnumIndex(row.parameterIndex, 0)
				else if (row.parameter.type === "int" || row.parameter.type === "double")
					row.commit(row.isNumber(row.parameter.minimum) ? String(row.parameter.minimum) : "0")
				checked = Qt.binding(() => row.editable)
			}
		}
	}
	OrlexLabel {
		x: switcher.width
		width: row.labelWidth - x
		height: Theme.controlHeight
		text: row.label
		toolTip: row.toolTip
		enabled: row.editable
	}
	Loader {
		id: editor
		x: row.labelWidth + Theme.spacing
		width: row.width - x - (resetter.active ? resetter.width + 2 : 0) - (unitLabel.active ? unitLabel.width + 4 : 0)
		enabled: row.editable
		Component.onCompleted: source = Qt.binding(() => row.editorUrl())
		onLoaded: {
			item.row = row
			item.width = Qt.binding(() => editor.width)
		}
	}
	Loader {
		id: unitLabel
		active: row.unit !== ""
		anchors.right: resetter.active ? resetter.left : parent.right
		sourceComponent: OrlexLabel {
			objectName: row.name + "Unit"
			height: Theme.controlHeight
			text: row.unit
			enabled: row.editable
		}
	}
	Loader {
		id: resetter
		active: row.defaultText !== "" && row.valueText !== row.defaultText
		anchors.right: parent.right
		sourceComponent: OrlexButton {
			objectName: row.name + "Reset"
			width: 16
			leftPadding: 0
			rightPadding: 0
			text: "\u21ba"
			toolTip: "Back to the default" + (row.defaultText !== "" ? ": " + row.defaultText : "")
			Accessible.name: row.label + ": back to the default"
			background: null
			onClicked: {
				row.error = ""
				row.groupModel.resetToDefault(row.parameterIndex)
			}
		}
	}
	Text {
		id: reason
		objectName: row.name + "Reason"
		visible: row.error !== ""
		x: editor.x
		y: editor.height + 2
		width: row.width - x
		text: row.error
		textFormat: Text.PlainText
		wrapMode: Text.Wrap
		font.pixelSize: Theme.fontSize - 1
		color: Theme.error
		Accessible.role: Accessible.AlertMessage
		Accessible.name: text
	}
}
