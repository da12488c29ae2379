import QtQuick 2.15
import Orlex.Controls 1.0
import Orlex.Theme 1.0

// A row for each parameter of a group model: label, editor and the way back to the default. Advanced parameters stand
// behind a fold. The editor of the parameter "X" has the objectName "X", its row "XRow".
FocusScope {
	id: view

	property var model: null
	property int labelWidth: 100
	// By a parameter's name, what it does not tell itself: {unit, check, none}. "check" gets what was typed and returns
	// why it is refused, or an empty text; "none" tells why there is nothing to choose from.
	property var hints: ({})
	property alias advancedShown: fold.checked
	property int generation: 0

	// All rows show what the parameters hold: to be called when these are of something else from now on. What was
	// refused is told in the log, since it is seen no longer.
	function restore() {
		generation += 1
	}

	implicitWidth: 260
	implicitHeight: column.implicitHeight
	Accessible.role: Accessible.Grouping
	Accessible.name: objectName

	Column {
		id: column
		width: parent.width
		spacing: Theme.spacing / 2

		ParameterSection {
			width: parent.width
			model: view.model
			labelWidth: view.labelWidth
			hints: view.hints
			generation: view.generation
		}
		OrlexDisclosure {
			id: fold
			objectName: view.objectName + "Advanced"
			visible: advanced.shownCount > 0
			text: "Advanced"
		}
		ParameterSection {
			id: advanced
			width: parent.width
			model: view.model
			labelWidth: view.labelWidth
			hints: view.hints
			generation: view.generation
			advanced: true
			visible: fold.checked && shownCount > 0
		}
	}
}
