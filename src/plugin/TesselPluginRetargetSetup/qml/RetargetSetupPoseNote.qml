import QtQuick 2.15
import QtQuick.Layouts 1.15
import Orlex.Controls 1.0
import Orlex.Theme 1.0

// Why a character lies, with what sets it upright.
Rectangle {
	id: note

	property Item panel: null

	objectName: "poseNote"
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
			onClicked: note.panel.run(() => ContextRetargetSetup.MatchFilePose())
		}
	}
}
