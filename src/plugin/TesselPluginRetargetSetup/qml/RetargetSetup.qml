import QtQuick 2.15
import QtQuick.Controls 2.15
import QtQuick.Dialogs 1.3
import QtQuick.Layouts 1.15
import QtQuick.Window 2.15
import Orlex.Controls 1.0
import Orlex.Selection 1.0
import Orlex.Tessel.Parameters 1.0
import Orlex.Theme 1.0
import TesselQML 1.0
import TesselPluginRetargetSetup 1.0

Rectangle {
	id: retargetSetup

	objectName: "retargetSetup"
	color: Theme.window

	property var subjectParametersModel: TesselParameters.ParameterGroupModel("RetargetSetup", "Subject")
	property var targetParametersModel: TesselParameters.ParameterGroupModel("RetargetSetup", "Target")
	property bool canAddTarget: RetargetSetupSelection.selectedSourceSegment !== -1
		&& RetargetSetupSelection.selectedTargetSegment !== -1
	// Why no target can be added, and what to do.
	readonly property string addTargetReason: canAddTarget ? ""
		: sourceSegments.count === 0 ? "There is no performer: choose a source skeleton."
		: targetSegments.count === 0 ? "There is no character: choose a target FBX, then create the target subject."
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
			RetargetSetupSelection.selectedTargetSegment, positionTarget, targetSymmetry.checked))
	}

	function isLegacy(url) {
		return url.toString().endsWith(".qrx")
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

	// Legacy files are only read: what came from one is saved under a new name.
	function save() {
		if (isLegacy(currentTargetSubjectURL))
			saveDialog.open()
		else
			saveTo(currentTargetSubjectURL)
	}

	function saveTo(url) {
		run(() => ContextRetargetSetup.SaveTargetSubjectURL(url))
	}

	// A file of another extension is one that "Load" does not show. The dialog has only asked about the name that was
	// typed.
	function saveAs(url) {
		if (/\.qr[rx]$/i.test(url))
			return saveTo(url)
		const whole = url + ".qrr"
		if (!contextQuickWidget.IsThere(whole))
			return saveTo(whole)
		replaceDialog.url = whole
		replaceDialog.open()
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

	OrlexFileDialog {
		id: loadDialog
		objectName: "loadDialog"
		title: "Choose a file"
		startFolder: ContextRetargetsUrl
		nameFilters: ["Subject files (*.qrr)", "Legacy subject files (*.qrx)"]
		onAccepted: {
			if (fileUrls.length === 1)
				retargetSetup.run(() => ContextRetargetSetup.LoadTargetSubjectURL(fileUrls[0]))
		}
	}
	OrlexFileDialog {
		id: saveDialog
		objectName: "saveDialog"
		title: "Choose a file"
		startFolder: ContextRetargetsUrl
		nameFilters: ["Subject files (*.qrr)"]
		selectExisting: false
		defaultSuffix: "qrr"
		onAccepted: {
			if (fileUrls.length === 1)
				retargetSetup.saveAs(fileUrls[0].toString())
		}
	}

	MessageDialog {
		id: replaceDialog

		property string url: ""

		objectName: "replaceDialog"
		title: "Save As"
		icon: StandardIcon.Warning
		text: Tessel.fileName(url) + " is there already. Do you want to replace it?"
		standardButtons: StandardButton.Yes | StandardButton.No
		onYes: retargetSetup.saveTo(url)
	}

	OrlexSplitView {
		id: columns

		readonly property real minimumWidth: leftColumn.minimumWidth + middle.SplitView.minimumWidth
			+ right.implicitWidth + 2 * 6

		objectName: "columns"
		anchors.fill: parent
		orientation: Qt.Horizontal

		Item {
			id: left

			SplitView.minimumWidth: leftColumn.minimumWidth
			SplitView.preferredWidth: leftColumn.minimumWidth

			// A disabled control lets the mouse through.
			MouseArea {
				id: behind
				anchors.fill: parent
				hoverEnabled: true
				acceptedButtons: Qt.NoButton
			}

			Flickable {
				id: leftView
				objectName: "leftView"
				anchors.fill: parent
				contentHeight: leftColumn.height + 2 * Theme.margin
				boundsBehavior: Flickable.StopAtBounds
				interactive: contentHeight > height
				clip: true
				ScrollBar.vertical: OrlexScrollBar {
					id: leftBar
				}

				// Scrolls until an item of the column can be seen.
				function reveal(item) {
					for (let parent = item; parent !== leftColumn; parent = parent.parent)
						if (!parent)
							return
					const top = item.mapToItem(leftColumn, 0, 0).y
					contentY = Math.max(Math.min(contentY, top), top + item.height + 2 * Theme.margin - height)
				}

				readonly property Item focusItem: Window.activeFocusItem
				onFocusItemChanged: reveal(focusItem)

				ColumnLayout {
					id: leftColumn

					readonly property real minimumWidth: Math.ceil(Math.max(fileButtons.implicitWidth,
						jointControls.implicitWidth, addControls.implicitWidth)) + 2 * Theme.margin + leftBar.width
					// The two boxes stand below each other.
					readonly property real symmetryWidth: Math.max(jointSymmetry.implicitWidth, targetSymmetry.implicitWidth)

					x: Theme.margin
					y: Theme.margin
					width: leftView.width - 2 * Theme.margin - (leftView.interactive ? leftBar.width : 0)
					height: Math.max(implicitHeight, leftView.height - 2 * Theme.margin)
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
							TargetScale: {
								check: text => retargetSetup.isNumber(text) && Number(text) > 0 ? ""
									: "\"" + text + "\" is no scale. Give a number above 0, such as 1.25."
							}
						})
						model: retargetSetup.subjectParametersModel
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
							text: "Current file: " + (retargetSetup.currentTargetSubjectURL
								? Tessel.fileName(retargetSetup.currentTargetSubjectURL) : "*None*")
						}
						OrlexLabel {
							objectName: "unsavedMark"
							visible: ContextRetargetSetup.unsavedChanges
							text: "\u25cf not saved"
							color: Theme.warning
							toolTip: "The target subject has changes that are in no file"
						}
					}

					RowLayout {
						id: fileButtons
						spacing: Theme.spacing

						OrlexButton {
							objectName: "createTargetSubject"
							Layout.fillWidth: true
							text: "Create Target Subject"
							toolTip: "Create a retarget skeleton for the selected FBX"
							onClicked: retargetSetup.run(() => ContextRetargetSetup.CreateTargetSubject())
						}
						OrlexButton {
							objectName: "load"
							text: "Load"
							toolTip: "Load an existing retarget skeleton from disk"
							onClicked: loadDialog.open()
						}
						OrlexButton {
							objectName: "save"
							text: "Save"
							toolTip: "Save the current retarget skeleton to the last filename"
							enabled: !!retargetSetup.currentTargetSubjectURL
							readonly property string disabledReason: "No retarget subject was loaded or saved yet: use Save As."
							onClicked: retargetSetup.save()
						}
						OrlexButton {
							objectName: "saveAs"
							text: "Save As"
							toolTip: "Save the current retarget skeleton to a new file"
							onClicked: saveDialog.open()
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
							onClicked: retargetSetup.run(() => ContextRetargetSetup.CreateAllJoints())
						}
						OrlexButton {
							objectName: "removeUnnecessaryJoints"
							Layout.fillWidth: true
							text: "Remove unnecessary joints"
							toolTip: "Remove joints from segments with no targets on themselves or their children"
							onClicked: retargetSetup.run(() => ContextRetargetSetup.RemoveUnnecessaryJoints())
						}
						PropertyCheckBox {
							id: jointSymmetry
							objectName: "jointSymmetry"
							Layout.preferredWidth: leftColumn.symmetryWidth
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
							enabled: retargetSetup.canAddTarget
							readonly property string disabledReason: retargetSetup.addTargetReason
							onClicked: retargetSetup.addTarget(true)
						}
						OrlexButton {
							objectName: "addRotationTarget"
							Layout.fillWidth: true
							text: "Add rotation target"
							toolTip: "Add a world-space rotation target for the selected segments. Shortcut: Alt+R"
							enabled: retargetSetup.canAddTarget
							readonly property string disabledReason: retargetSetup.addTargetReason
							onClicked: retargetSetup.addTarget(false)
						}
						OrlexCheckBox {
							id: targetSymmetry
							objectName: "targetSymmetry"
							Layout.preferredWidth: leftColumn.symmetryWidth
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
							onClicked: retargetSetup.run(() => ContextRetargetSetup.MatchFilePose())
						}
						OrlexButton {
							objectName: "updateTargets"
							Layout.fillWidth: true
							text: "Update targets"
							toolTip: "Recalculate offsets to each target based on the current pose"
							onClicked: retargetSetup.run(() => ContextRetargetSetup.UpdateTargets())
						}
						PropertyCheckBox {
							objectName: "scaleRootHeight"
							text: "Scale root height"
							toolTip: "Scale the height of the root above the floor, too, so that the feet stay on it"
							target: ContextRetargetSetup
							property: "scaleRootHeight"
						}
					}

					RetargetSetupTargetTable {
						objectName: "targets"
						Layout.fillWidth: true
						Keys.onDeletePressed: if (removeTarget.enabled) removeTarget.act()
						emptyText: targetSegments.count === 0
							? "Choose a source skeleton and a target FBX above, then create the target subject."
							: sourceSegments.count === 0 ? "Choose a source skeleton above."
							: "Select one segment in each list on the right, or in the view, where a click with "
							+ "Shift or Ctrl adds to what is selected. Then add a target."
						Layout.fillHeight: true
						// Five rows under their header.
						Layout.minimumHeight: 6 * Theme.itemHeight
					}

					OrlexButton {
						id: removeTarget
						objectName: "removeTarget"
						Layout.fillWidth: true
						text: "Remove target"
						toolTip: "Delete the selected target"
						enabled: RetargetSetupSelection.selectedTarget !== -1
						readonly property string disabledReason: retargetSetup.targetReason
						onClicked: retargetSetup.run(() => ContextRetargetSetup.RemoveTarget(RetargetSetupSelection.selectedTarget))
					}

					ParameterView {
						id: targetParameters

						// What was typed for one target must not stand at another.
						readonly property int shownTarget: RetargetSetupSelection.selectedTarget

						objectName: "targetParameters"
						Layout.fillWidth: true
						readonly property string disabledReason: retargetSetup.targetReason
						enabled: shownTarget !== -1
						// Nothing below or above moves when a rotation target is chosen, which shows less.
						Layout.minimumHeight: 4 * Theme.controlHeight + 3 * Theme.spacing / 2
						hints: ({
							TargetStateExpressionX: retargetSetup.lengthHint,
							TargetStateExpressionY: retargetSetup.lengthHint,
							TargetStateExpressionZ: retargetSetup.lengthHint
						})
						model: retargetSetup.targetParametersModel
						onShownTargetChanged: restore()
					}
				}
			}
		}

		ColumnLayout {
			id: middle

			SplitView.fillWidth: true
			SplitView.minimumWidth: viewControls.implicitWidth + 2 * Theme.margin
			spacing: 0

			RowLayout {
				id: viewControls
				Layout.margins: Theme.spacing
				spacing: Theme.spacing

				OrlexComboBox {
					id: cameraTypes
					objectName: "cameraType"
					Layout.preferredWidth: 100
					Accessible.name: "Camera"
					model: ["Perspective", "Front", "Back", "Left", "Right", "Top", "Bottom"]
					currentIndex: 0
				}
				OrlexButton {
					id: viewFilters
					objectName: "viewFilters"
					text: "View Filters"
					checkable: true
					checked: true
				}
				OrlexButton {
					objectName: "showManipulator"
					text: "Show Manipulator"
					checkable: true
					checked: true
					onToggled: sceneFBO.sceneOptions["Manipulator"] = checked
				}
			}

			Item {
				Layout.fillWidth: true
				Layout.fillHeight: true
				clip: true

				SceneFramebufferObject {
					id: sceneFBO

					objectName: "scene"
					anchors.fill: parent
					scene: FlowScene
					focusSelection: FocusSelection
					cameraType: cameraTypes.currentIndex
					Accessible.role: Accessible.Graphic
					Accessible.name: "Preview"

					Component.onCompleted: {
						const options = FlowScene.viewOptions
						for (const key in options)
							sceneOptions[key] = options[key]
					}
				}

				Column {
					objectName: "filters"
					visible: viewFilters.checked
					x: Theme.margin
					y: Theme.margin

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
							target: sceneFBO.sceneOptions
							property: modelData.option
							onToggled: {
								if (modelData.other !== "")
									sceneFBO.sceneOptions[modelData.other] = checked
							}
						}
					}
				}

				// Why a character lies, with what sets it upright; the axes stand beside it.
				Rectangle {
					objectName: "poseNote"
					anchors {
						left: parent.left
						right: parent.right
						bottom: parent.bottom
						leftMargin: 108
						rightMargin: Theme.margin
						bottomMargin: Theme.margin
					}
					height: poseNote.implicitHeight + 2 * Theme.spacing
					visible: ContextRetargetSetup.poseNote !== ""
					radius: Theme.radius
					color: Theme.window
					border.color: Theme.warning

					RowLayout {
						id: poseNote
						anchors {
							left: parent.left
							right: parent.right
							verticalCenter: parent.verticalCenter
							margins: Theme.spacing
						}
						spacing: Theme.spacing

						OrlexLabel {
							Layout.fillWidth: true
							text: ContextRetargetSetup.poseNote
							wrapMode: Text.Wrap
							elide: Text.ElideNone
						}
						OrlexButton {
							objectName: "poseNoteMatch"
							text: "Take pose from FBX"
							onClicked: retargetSetup.run(() => ContextRetargetSetup.MatchFilePose())
						}
					}
				}

				SceneToolTip {
					scene: sceneFBO
				}
			}

			RetargetSetupStatus {
				id: status
				objectName: "status"
				Layout.fillWidth: true
				page: left
				place: Qt.point(behind.mouseX, behind.mouseY)
				pointing: behind.containsMouse
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

			ColumnLayout {
				anchors.fill: parent
				spacing: 0

				OrlexLabel {
					Layout.margins: Theme.spacing
					Layout.fillWidth: true
					text: "Source Segments"
					color: Theme.windowText
				}
				RetargetSetupSegmentList {
					id: sourceSegments
					objectName: "sourceSegments"
					Layout.fillWidth: true
					Layout.fillHeight: true
					title: "Source Segments"
					model: SourceSegmentModel
					mappingOf: name => retargetSetup.mappingOf(name, true)
					selectedIndex: RetargetSetupSelection.selectedSourceSegment
				}
				OrlexLabel {
					Layout.margins: Theme.spacing
					Layout.fillWidth: true
					text: "Target Segments"
					color: Theme.bright
				}
				RetargetSetupSegmentList {
					id: targetSegments
					objectName: "targetSegments"
					Layout.fillWidth: true
					Layout.fillHeight: true
					title: "Target Segments"
					model: TargetSegmentModel
					marksJoints: true
					mappingOf: name => retargetSetup.mappingOf(name, false)
					selectedIndex: RetargetSetupSelection.selectedTargetSegment
				}
			}
		}
	}
}
