import QtQuick 2.15
import QtQuick.Templates 2.15 as T
import Orlex.Theme 1.0

// Shown by its owner's binding of "visible"; long texts wrap.
T.ToolTip {
	id: control

	readonly property real widest: 360

	x: parent ? Math.round((parent.width - implicitWidth) / 2) : 0
	// Above its owner, or below where it would cover it.
	y: parent && parent.mapToItem(null, 0, 0).y < implicitHeight + 8 ? parent.height + 4 : -implicitHeight - 4
	implicitWidth: Math.min(widest, Math.ceil(contentItem.implicitWidth)) + leftPadding + rightPadding
	implicitHeight: contentItem.implicitHeight + topPadding + bottomPadding
	margins: 4
	padding: 5
	leftPadding: 7
	rightPadding: 7
	// Never takes a press from what it covers.
	enabled: false
	delay: Theme.infoToolTipDelay
	// Escape is for what the tip is about.
	closePolicy: T.Popup.CloseOnPressOutsideParent | T.Popup.CloseOnReleaseOutsideParent

	contentItem: Text {
		text: control.text
		textFormat: Text.PlainText
		font.pixelSize: Theme.fontSize
		color: Theme.text
		wrapMode: Text.Wrap
	}

	background: Rectangle {
		color: Theme.mid
		border.color: Theme.border
		radius: Theme.radius
	}
}
