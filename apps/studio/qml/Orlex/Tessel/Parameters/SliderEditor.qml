import QtQuick 2.15
import Orlex.Controls 1.0
import Orlex.Theme 1.0

// A number between two limits, dragged or typed. A value beyond them (a file may bring one) stands in the field as it
// is and at the slider's end.
Item {
	id: editor

	property var row
	readonly property real from: row ? row.parameter.minimum : 0
	readonly property real to: row ? row.parameter.maximum : 1
	readonly property bool whole: !!row && row.parameter.type === "int"
	// About a thousandth of the way, as a power of ten, so that dragging gives short numbers.
	readonly property int decimals: whole ? 0 : Math.max(0, Math.min(12, 2 - Math.floor(Math.log10(to - from))))
	readonly property real step: Math.pow(10, -decimals)

	function follow() {
		slider.value = Qt.binding(() => row && row.isNumber(row.parameter.value) ? row.parameter.value : from)
	}

	implicitHeight: Theme.controlHeight
	onRowChanged: {
		field.row = row
		follow()
	}

	OrlexSlider {
		id: slider
		objectName: editor.row ? editor.row.name + "Slider" : ""
		width: parent.width - field.width - 6
		from: editor.from
		to: editor.to
		stepSize: editor.step
		Accessible.name: editor.row ? editor.row.label : ""
		onMoved: {
			const rounded = Math.max(from, Math.min(to, Number(value.toFixed(editor.decimals))))
			if (!editor.row.commit(String(rounded)) || !pressed)
				editor.follow()
		}
		onPressedChanged: if (!pressed) editor.follow()
	}
	TextEditor {
		id: field
		anchors.right: parent.right
		width: 64
	}
}
