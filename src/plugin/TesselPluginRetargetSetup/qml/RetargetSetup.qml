import QtQuick 2.15
import QtQuick.Controls 2.15
import QtQuick.Layouts 1.15
import QtQuick.Window 2.15
import Orlex.Controls 1.0
import Orlex.Tessel.Parameters 1.0
import Orlex.Theme 1.0
import TesselPluginRetargetSetup 1.0

Rectangle {
	id: retargetSetup

	objectName: "retargetSetup"
	color: Theme.window

	property var subjectParametersModel: TesselParameters.ParameterGroupModel("RetargetSetup", "Subject")
	property var targetParametersModel: TesselParameters.ParameterGroupModel("RetargetSetup", "Target")
	readonly property alias sourceCount: segments.sourceCount
	readonly property alias targetCount: segments.targetCount
	property bool canAddTarget: RetargetSetupSelection.selectedSourceSegment !== -1
		&& RetargetSetupSelection.selectedTargetSegment !== -1
	// Why no target can be added, and what to do.
	readonly property string addTargetReason: canAddTarget ? ""
		: sourceCount === 0 ? "There is no performer: choose a source skeleton."
		: targetCount === 0 ? "There is no character: choose a target FBX, then create the target subject."
		: countReason(RetargetSetupSelection.sourceSegmentCount, "source segment")
		|| countReason(RetargetSetupSelection.targetSegmentCount, "target segment")
	readonly property string targetReason: countReason(RetargetSetupSelection.targetCount, "target")
	// Why the selected segment has no manipulator.
	readonly property string jointReason: {
		const index = RetargetSetupSelection.selectedTargetSegment
		return canAddTarget || index === -1 || TargetSegmentModel.HasJoint(index) ? "" : segmentName(TargetSegmentModel, index)
			+ " has no joint, so nothing turns it: \"Create all joints\" gives it one."
	}
	// What "Save" writes: the file that was last loaded or saved.
	property var currentTargetSubjectURL: null

	// Below these something would be cut off.
	readonly property real minimumWidth: columns.minimumWidth
	readonly property real minimumHeight: 15 * Theme.itemHeight

	Accessible.role: Accessible.Pane
	Accessible.name: "Retarget Setup"

	// Why it is not exactly one that is selected; empty if it is.
	function countReason(count, what) {
		return count === 0 ? "No " + what + " is selected: select one."
			: count > 1 ? count + " " + what + "s are selected: select only one." : ""
	}

	// A line for each target of a segment, source or target.
	function mappingOf(name, source) {
		const roles = RetargetSetupTargetModel
		const lines = []
		for (let row = 0; row < TargetModel.rowCount(); ++row) {
			const index = TargetModel.index(row, 0)
			const pair = [TargetModel.data(index, roles.SourceSegment), TargetModel.data(index, roles.TargetSegment)]
			if (pair[source ? 0 : 1] === name)
				lines.push(TargetModel.data(index, roles.TargetType) + " target " + (source ? "of " + pair[1] : "at " + pair[0]))
		}
		return lines.join("\n")
	}

	// What the mouse points at in the view: the files name both subjects alike, so that they are told apart by the names
	// of performer and character. One thing is told in full.
	function describePointed(text) {
		const things = text === "" ? [] : FlowScene.PointedAt()
		if (things.length === 0)
			return text
		const most = 10
		const lines = things.map(thing => {
			if (thing.kind === FlowScene.targetKind) {
				const index = TargetModel.index(thing.index, 0)
				const of = role => TargetModel.data(index, role)
				return of(RetargetSetupTargetModel.TargetType) + " target: " + of(RetargetSetupTargetModel.SourceSegment)
					+ " to " + of(RetargetSetupTargetModel.TargetSegment)
			}
			const source = thing.kind === FlowScene.sourceSegmentKind
			const name = segmentName(source ? SourceSegmentModel : TargetSegmentModel, thing.index)
			const mapping = things.length === 1 ? mappingOf(name, source) : ""
			return thing.subject + " : " + name + (mapping === "" ? "" : "\n" + mapping)
		})
		lines.sort()
		return lines.slice(0, most).concat(lines.length > most ? ["..."] : []).join("\n")
	}

	function segmentName(model, index) {
		return model.data(model.index(index, 0), RetargetSetupSegmentModel.Name)
	}

	// In the form that files have, whatever the computer's language.
	function isNumber(text) {
		return /^\s*[-+]?(\d+\.?\d*|\.\d+)([eE][-+]?\d+)?\s*$/.test(text) && isFinite(Number(text))
	}
	readonly property var lengthHint: ({
		unit: "mm",
		check: text => text.trim() === "" || isNumber(text) ? ""
			: "\"" + text + "\" is no length. Give a number of mm, such as -12.5."
	})

	function addTarget(positionTarget) {
		run(() => ContextRetargetSetup.AddTarget(RetargetSetupSelection.selectedSourceSegment,
			RetargetSetupSelection.selectedTargetSegment, positionTarget, commands.mirrored))
	}

	// The one that takes its place is selected then, or the one before it.
	function removeTarget() {
		run(() => {
			const index = RetargetSetupSelection.selectedTarget
			ContextRetargetSetup.RemoveTarget(index)
			if (TargetModel.rowCount() > 0)
				RetargetSetupSelection.SelectTarget(Math.min(index, TargetModel.rowCount() - 1))
		})
	}

	function tell(reason) {
		status.told = reason
	}

	// A command acts on what the operator sees: on what stands in a field that is still being typed into, and on what
	// was set and selected just before.
	function run(command) {
		commitField()
		command()
	}

	function commitField() {
		finishField()
		contextQuickWidget.ApplyParameters()
	}

	// What is unsaved is then told with what is being typed.
	function commitEdits() {
		finishField()
		contextQuickWidget.ApplyEdits()
	}

	function finishField() {
		const field = retargetSetup.Window.activeFocusItem
		if (field && field.editingFinished !== undefined) {
			retargetSetup.forceActiveFocus()
			field.forceActiveFocus()
		}
	}

	function save() {
		fileDialogs.save()
	}

	Connections {
		target: ContextRetargetSetup
		// Of whatever asked for it; a file that could not be loaded is never what "Save" overwrites.
		function onTargetSubjectLoaded(url) {
			retargetSetup.currentTargetSubjectURL = url
		}
		function onTargetSubjectSaved(url) {
			retargetSetup.currentTargetSubjectURL = url
		}
		// Otherwise the next "Save" would put one character in the place of another.
		function onTargetSubjectCreated() {
			retargetSetup.currentTargetSubjectURL = null
		}
		function onTargetSubjectBroughtBack(url) {
			retargetSetup.currentTargetSubjectURL = url.toString() === "" ? null : url
		}
		function onCommandIgnored(command, reason) {
			status.told = reason
		}
	}
	Connections {
		target: RetargetSetupSelection
		function onCountsChanged() {
			status.told = ""
		}
	}
	Connections {
		target: TargetSegmentModel
		function onModelReset() {
			status.told = ""
			// What is made next is no longer that file's.
			if (TargetSegmentModel.rowCount() === 0)
				retargetSetup.currentTargetSubjectURL = null
		}
	}

	Shortcut {
		sequences: ["Alt+T", "Alt+R"]
		enabled: !retargetSetup.canAddTarget
		onActivated: status.told = retargetSetup.addTargetReason
	}
	Shortcut {
		sequence: "Alt+T"
		enabled: retargetSetup.canAddTarget
		onActivated: retargetSetup.addTarget(true)
	}
	Shortcut {
		sequence: "Alt+R"
		enabled: retargetSetup.canAddTarget
		onActivated: retargetSetup.addTarget(false)
	}

	RetargetSetupMenu {
		id: contextMenu
		panel: retargetSetup
		sourceList: segments.sourceList
		targetList: segments.targetList
	}
	RetargetSetupFiles {
		id: fileDialogs
		panel: retargetSetup
	}

	OrlexSplitView {
		id: columns

		readonly property real minimumWidth: leftPage.minimumWidth + view.minimumWidth + right.implicitWidth + 2 * 6

		objectName: "columns"
		anchors.fill: parent
		orientation: Qt.Horizontal

		RetargetSetupPage {
			id: leftPage

			SplitView.minimumWidth: minimumWidth
			SplitView.preferredWidth: minimumWidth
			contentWidth: commands.minimumWidth

			RetargetSetupSubjects {
				panel: retargetSetup
				Layout.fillHeight: false
			}
			RetargetSetupCommands {
				id: commands
				panel: retargetSetup
				Layout.fillHeight: false
				files: fileDialogs
			}
			RetargetSetupTargets {
				panel: retargetSetup
				menu: contextMenu
			}
		}

		ColumnLayout {
			SplitView.fillWidth: true
			SplitView.minimumWidth: view.minimumWidth
			spacing: 0

			RetargetSetupView {
				id: view
				panel: retargetSetup
				menu: contextMenu
			}
			RetargetSetupStatus {
				id: status
				objectName: "status"
				Layout.fillWidth: true
				page: leftPage
				place: leftPage.place
				pointing: leftPage.pointing
				next: retargetSetup.jointReason || retargetSetup.addTargetReason || "Alt+T ties "
					+ segmentName(TargetSegmentModel, RetargetSetupSelection.selectedTargetSegment) + " to "
					+ segmentName(SourceSegmentModel, RetargetSetupSelection.selectedSourceSegment)
					+ " by position, Alt+R by rotation."
			}
		}

		Item {
			id: right

			implicitWidth: 200
			SplitView.minimumWidth: 120

			RetargetSetupSegments {
				id: segments
				anchors.fill: parent
				panel: retargetSetup
				menu: contextMenu
			}
		}
	}
}
