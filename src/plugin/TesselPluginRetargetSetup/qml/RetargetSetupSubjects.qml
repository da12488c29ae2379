import QtQuick 2.15
import QtQuick.Layouts 1.15
import Orlex.Controls 1.0
import Orlex.Tessel.Parameters 1.0
import Orlex.Theme 1.0
import TesselQML 1.0

// Performer and character, what there is to say of them, and the file of the target subject.
ColumnLayout {
	id: subjects

	property Item panel: null

	spacing: Theme.spacing

	OrlexDisclosure {
		id: fold
		objectName: "files"
		text: "Performer and character"
		checked: true
	}
	ParameterView {
		objectName: "subjectParameters"
		visible: fold.checked
		Layout.fillWidth: true
		hints: ({
			SourceSkeleton: { none: "The folders of the preferences hold no source skeleton (.qrs)." },
			TargetRoot: { none: "Choose a target FBX: its bones are listed here." },
			TargetScale: {
				check: text => subjects.panel.isNumber(text) && Number(text) > 0 ? ""
					: "\"" + text + "\" is no scale. Give a number above 0, such as 1.25."
			}
		})
		model: subjects.panel.subjectParametersModel
	}

	Text {
		objectName: "remarks"
		Layout.fillWidth: true
		Layout.preferredWidth: 0
		visible: text !== ""
		text: contextQuickWidget.remarks
		textFormat: Text.PlainText
		wrapMode: Text.Wrap
		font.pixelSize: Theme.fontSize
		color: Theme.warning
		Accessible.role: Accessible.AlertMessage
		Accessible.name: text
	}

	RowLayout {
		spacing: Theme.spacing

		OrlexLabel {
			objectName: "currentFile"
			Layout.fillWidth: true
			text: "Current file: " + (subjects.panel.currentTargetSubjectURL
				? Tessel.fileName(subjects.panel.currentTargetSubjectURL) : "*None*")
		}
		OrlexLabel {
			objectName: "unsavedMark"
			visible: ContextRetargetSetup.unsavedChanges
			text: "\u25cf not saved"
			color: Theme.warning
			toolTip: "The target subject has changes that are in no file"
		}
	}
}
