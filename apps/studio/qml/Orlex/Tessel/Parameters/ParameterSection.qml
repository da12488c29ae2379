import QtQuick 2.15
import Orlex.Theme 1.0

// The rows of a model that are advanced, or those that are not; hidden ones are in neither.
Column {
	id: section

	property var model: null
	property bool advanced: false
	property int labelWidth: 100
	property var hints: ({})
	property int generation: 0
	property int shownCount: 0

	function categoryBefore(index) {
		for (let i = index - 1; i >= 0; --i) {
			const row = rows.itemAt(i)
			if (row && row.shown)
				return row.category
		}
		return ""
	}

	spacing: Theme.spacing / 2

	Repeater {
		id: rows
		model: section.model

		Column {
			id: entry

			readonly property bool shown: !model.hidden && !!model.advanced === section.advanced
			readonly property string category: model.category || ""
			readonly property var parameter: model
			readonly property int parameterIndex: index
			property bool counted: false

			function count(counts) {
				if (counts !== counted)
					section.shownCount += counts ? 1 : -1
				counted = counts
			}

			width: section.width
			visible: shown
			onShownChanged: count(shown)
			Component.onCompleted: count(shown)
			Component.onDestruction: if (section) count(false)

			Text {
				visible: entry.category !== "" && section.shownCount > 0
					&& section.categoryBefore(entry.parameterIndex) !== entry.category
				text: entry.category
				textFormat: Text.PlainText
				width: parent.width
				height: Theme.itemHeight
				font.pixelSize: Theme.fontSize
				font.bold: true
				color: Theme.windowText
				verticalAlignment: Text.AlignVCenter
				elide: Text.ElideRight
			}
			Loader {
				width: parent.width
				active: entry.shown
				sourceComponent: ParameterRow {
					parameter: entry.parameter
					parameterIndex: entry.parameterIndex
					groupModel: section.model
					labelWidth: section.labelWidth
					hint: section.hints[entry.parameter.name] || ({})
					generation: section.generation
				}
			}
		}
	}
}
