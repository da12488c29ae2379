import QtQuick 2.15
import QtQuick.Templates 2.15 as T
import Orlex.Theme 1.0

// Several lines of text in a frame, which scrolls to the cursor.
FieldFrame {
	id: frame

	property alias text: area.text
	property alias area: area
	property string error: ""

	// Ctrl+Enter.
	signal accepted()

	implicitHeight: 4 * Theme.itemHeight
	focused: area.activeFocus
	hovered: area.hovered
	invalid: error !== ""

	Flickable {
		id: flickable
		anchors.fill: parent
		anchors.margins: 1
		clip: true
		boundsBehavior: Flickable.StopAtBounds
		T.ScrollBar.vertical: OrlexScrollBar {}

		T.TextArea.flickable: T.TextArea {
			id: area
			leftPadding: 6
			rightPadding: 12
			topPadding: 4
			bottomPadding: 4
			font.pixelSize: Theme.fontSize
			color: enabled ? Theme.text : Theme.disabledText
			selectionColor: Theme.highlight
			selectedTextColor: Theme.bright
			placeholderTextColor: Theme.disabledText
			wrapMode: TextEdit.Wrap
			textFormat: TextEdit.PlainText
			selectByMouse: true
			hoverEnabled: true
			// Tab goes on to the next control.
			Keys.onTabPressed: nextItemInFocusChain(true).forceActiveFocus(Qt.TabFocusReason)
			Keys.onBacktabPressed: nextItemInFocusChain(false).forceActiveFocus(Qt.BacktabFocusReason)
			Keys.onPressed: {
				event.accepted = (event.key === Qt.Key_Return || event.key === Qt.Key_Enter)
					&& (event.modifiers & Qt.ControlModifier) !== 0
				if (event.accepted)
					frame.accepted()
			}
			Accessible.role: Accessible.EditableText
			Accessible.multiLine: true
			Accessible.name: frame.Accessible.name
			Accessible.description: frame.error
		}
	}
}
