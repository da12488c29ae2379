import QtQuick 2.15
import Orlex.Controls 1.0

// What the view shows of both subjects.
Column {
	id: filters

	// Of the scene.
	property var options: null

	Repeater {
		model: [
			{ text: "Constraints", option: "SolvingSubject-Targets", other: "", indent: 0 },
			{ text: "Joints", option: "LabellingSubject-Joints", other: "SolvingSubject-Joints", indent: 0 },
			{ text: "Segment Axes", option: "LabellingSubject-Axes", other: "SolvingSubject-Axes", indent: 0 },
			{ text: "Source Skin", option: "LabellingSubject-Skin", other: "", indent: 0 },
			{ text: "Source Skin X-Ray", option: "LabellingSubject-SkinXRay", other: "", indent: 10 },
			{ text: "Target Skin", option: "SolvingSubject-Skin", other: "", indent: 0 },
			{ text: "Target Skin X-Ray", option: "SolvingSubject-SkinXRay", other: "", indent: 10 }
		]

		PropertyCheckBox {
			objectName: "filter" + modelData.text.replace(/[ -]/g, "")
			x: modelData.indent
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
