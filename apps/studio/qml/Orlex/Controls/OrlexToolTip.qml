import QtQuick 2.15
import QtQuick.Templates 2.15 as T
import Orlex.Theme 1.0

// Shown by its owner's binding of "visible"; long texts wrap.
T.ToolTip {
	id: control

	readonly property real widest: 360

	x: parent ? Math.round((parent.width - implicitWidth) / 2) : 0
	y: -implicitHeight - 4
	implicitWidth: contentItem.implicitWidth + leftPadding + rightPadding
	implicitHeight: contentItem.implicitHeight + topPadding + bottomPadding
	margins: 4
	padding: 5
	leftPadding: 7
	rightPadding: 7
	delay: Theme.infoToolTipDelay
	closePolicy: T.Popup.CloseOnEscape | T.Popup.CloseOnPressOutsideParent | T.Popup.CloseOnReleaseOutsideParent

	contentItem: Text {
		// The text's own width asks a text of its own, since a wrapped one tells what it was given.
		readonly property TextMetrics metrics: TextMetrics {
			font: control.contentItem.font
			text: control.text
		}
		text: control.text
		textFormat: Text.PlainText
		font.pixelSize: Theme.fontSize
		color: Theme.text
		wrapMode: Text.Wrap
		width: Math.min(control.widest, Math.ceil(metrics.advanceWidth) + 1)
	}

	background: Rectangle {
		color: Theme.mid
		border.color: Theme.border
		radius: Theme.radius
	}
}
