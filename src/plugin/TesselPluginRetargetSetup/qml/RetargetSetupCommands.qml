import QtQuick 2.15
import QtQuick.Layouts 1.15
import Orlex.Controls 1.0
import Orlex.Theme 1.0

// The buttons that make, save and edit the target subject.
ColumnLayout {
	id: commands

	property Item panel: null
	property Item files: null
	readonly property alias mirrored: targetSymmetry.checked
	// Below this something would be cut off.
	readonly property real minimumWidth: Math.max(fileButtons.implicitWidth, jointControls.implicitWidth,
		addControls.implicitWidth)
	// The two boxes stand below each other.
	readonly property real symmetryWidth: Math.max(jointSymmetry.implicitWidth, targetSymmetry.implicitWidth)

	spacing: Theme.spacing

	RowLayout {
		id: fileButtons
		spacing: Theme.spacing

		OrlexButton {
			objectName: "createTargetSubject"
			Layout.fillWidth: true
			text: "Create Target Subject"
			toolTip: "Create a retarget skeleton for the selected FBX"
			onClicked: commands.panel.run(() => ContextRetargetSetup.CreateTargetSubject())
		}
		OrlexButton {
			objectName: "load"
			text: "Load"
			toolTip: "Load an existing retarget skeleton from disk"
			onClicked: commands.files.load()
		}
		OrlexButton {
			objectName: "save"
			text: "Save"
			toolTip: "Save the current retarget skeleton to the last filename"
			enabled: !!commands.panel.currentTargetSubjectURL
			readonly property string disabledReason: "No retarget subject was loaded or saved yet: use Save As."
			onClicked: commands.panel.save()
		}
		OrlexButton {
			objectName: "saveAs"
			text: "Save As"
			toolTip: "Save the current retarget skeleton to a new file"
			onClicked: commands.files.askWhere()
		}
	}

	RowLayout {
		id: jointControls
		spacing: Theme.spacing

		OrlexButton {
			objectName: "createAllJoints"
			Layout.fillWidth: true
			text: "Create all joints"
			toolTip: "Add a joint to every segment in the retarget skeleton"
			onClicked: commands.panel.run(() => ContextRetargetSetup.CreateAllJoints())
		}
		OrlexButton {
			objectName: "removeUnnecessaryJoints"
			Layout.fillWidth: true
			text: "Remove unnecessary joints"
			toolTip: "Remove joints from segments with no targets on themselves or their children"
			onClicked: commands.panel.run(() => ContextRetargetSetup.RemoveUnnecessaryJoints())
		}
		PropertyCheckBox {
			id: jointSymmetry
			objectName: "jointSymmetry"
			Layout.preferredWidth: commands.symmetryWidth
			text: "Joint symmetry"
			toolTip: "Apply mirrored rotation to left and right segments"
			target: ContextRetargetSetup
			property: "jointSymmetry"
		}
	}

	RowLayout {
		id: addControls
		spacing: Theme.spacing

		OrlexButton {
			objectName: "addPositionTarget"
			Layout.fillWidth: true
			text: "Add position target"
			toolTip: "Add a world-space position target for the selected segments. Shortcut: Alt+T"
			enabled: commands.panel.canAddTarget
			readonly property string disabledReason: commands.panel.addTargetReason
			onClicked: commands.panel.addTarget(true)
		}
		OrlexButton {
			objectName: "addRotationTarget"
			Layout.fillWidth: true
			text: "Add rotation target"
			toolTip: "Add a world-space rotation target for the selected segments. Shortcut: Alt+R"
			enabled: commands.panel.canAddTarget
			readonly property string disabledReason: commands.panel.addTargetReason
			onClicked: commands.panel.addTarget(false)
		}
		OrlexCheckBox {
			id: targetSymmetry
			objectName: "targetSymmetry"
			Layout.preferredWidth: commands.symmetryWidth
			text: "Target symmetry"
			toolTip: "Create matching targets on left and right"
		}
	}

	RowLayout {
		spacing: Theme.spacing

		OrlexButton {
			objectName: "matchFilePose"
			Layout.fillWidth: true
			text: "Take pose from FBX"
			toolTip: "Pose the retarget skeleton as the bones stand in the selected FBX"
			onClicked: commands.panel.run(() => ContextRetargetSetup.MatchFilePose())
		}
		OrlexButton {
			objectName: "updateTargets"
			Layout.fillWidth: true
			text: "Update targets"
			toolTip: "Recalculate offsets to each target based on the current pose"
			onClicked: commands.panel.run(() => ContextRetargetSetup.UpdateTargets())
		}
		PropertyCheckBox {
			objectName: "scaleRootHeight"
			text: "Scale root height"
			toolTip: "Scale the height of the root above the floor, too, so that the feet stay on it"
			target: ContextRetargetSetup
			property: "scaleRootHeight"
		}
	}
}
