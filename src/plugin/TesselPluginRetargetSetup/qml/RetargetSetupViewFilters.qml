import QtQuick 2.15
import Orlex.Controls 1.0

// What the view shows of both subjects.
Column {
	id: filters

	// Of the scene.
	property var options: null
	readonly property real indent: 10

	rightPadding: indent

	Repeater {
		model: [
			{ text: "Constraints", option: "SolvingSubject-Targets", other: "", indented: false },
			{ text: "Joints", option: "LabellingSubject-Joints", other: "SolvingSubject-Joints", indented: false },
			{ text: "Segment Axes", option: "LabellingSubject-Axes", other: "SolvingSubject-Axes", indented: false },
			{ text: "Source Skin", option: "LabellingSubject-Skin", other: "", indented: false },
			{ text: "Source Skin X-Ray", option: "LabellingSubject-SkinXRay", other: "", indented: true },
			{ text: "Target Skin", option: "SolvingSubject-Skin", other: "", indented: false },
			{ text: "Target Skin X-Ray", option: "SolvingSubject-SkinXRay", other: "", indented: true }
		]

		PropertyCheckBox {
			objectName: "filter" + modelData.text.replace(/[ -]/g, "")
			x: modelData.indented ? filters.indent : 0
			text: modelData.text
			target: filters.options
			property: modelData.option
			onToggled: {
				if (modelData.other !== "")
					filters.options[modelData.other] = checked
			}
		}
	}
}
