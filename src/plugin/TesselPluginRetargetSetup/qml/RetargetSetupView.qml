import QtQuick 2.15
import QtQuick.Layouts 1.15
import Orlex.Controls 1.0
import Orlex.Theme 1.0
import TesselPluginRetargetSetup 1.0

// The preview, with what is chosen for it above it.
ColumnLayout {
	id: view

	property Item panel: null
	property Item menu: null
	// Below this something would be cut off.
	readonly property real minimumWidth: viewControls.implicitWidth + 2 * Theme.margin

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
				FrameAll()
			}

			// A drag with this button goes nearer.
			TapHandler {
				acceptedButtons: Qt.RightButton
				onPressedChanged: if (pressed) FlowScene.RememberPointedAt()
				onTapped: view.menu.openForView(sceneFBO, eventPoint.position.x, eventPoint.position.y)
			}
		}
		Connections {
			target: FlowScene
			function onSubjectAppeared() {
				sceneFBO.FrameAll()
			}
			function onFramePublished() {
				sideSeen.update()
			}
		}

		RetargetSetupViewGround {
			visible: viewFilters.checked
			x: Theme.margin
			y: Theme.margin

			RetargetSetupViewFilters {
				objectName: "filters"
				options: sceneFBO.sceneOptions
			}
		}

		// A fixed view is named for the stage, and the character may face any way on it.
		RetargetSetupViewGround {
			visible: sideSeen.text !== ""
			anchors {
				right: parent.right
				top: parent.top
				margins: Theme.margin
			}

			OrlexLabel {
				id: sideSeen

				readonly property int cameraType: cameraTypes.currentIndex

				objectName: "sideSeen"
				color: Theme.windowText
				onCameraTypeChanged: update()

				function update() {
					const side = FlowScene.SideSeen(cameraType)
					text = side === "" ? "" : "The character's " + side
				}
			}
		}

		// The axes stand beside it.
		RetargetSetupPoseNote {
			panel: view.panel
			anchors {
				left: parent.left
				right: parent.right
				bottom: parent.bottom
				leftMargin: 108
				rightMargin: Theme.margin
				bottomMargin: Theme.margin
			}
		}

		SceneToolTip {
			scene: sceneFBO
			describe: text => view.panel.describePointed(text)
		}
	}
}
