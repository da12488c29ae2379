import QtQuick 2.15
import Orlex.Theme 1.0

// A ground for what stands over the view, so that it can be read whatever the view shows.
Rectangle {
	default property alias content: inside.data

	width: inside.childrenRect.width + 2 * Theme.spacing
	height: inside.childrenRect.height + 2 * Theme.spacing
	color: Qt.rgba(Theme.window.r, Theme.window.g, Theme.window.b, 0.8)
	radius: Theme.radius

	Item {
		id: inside
		x: Theme.spacing
		y: Theme.spacing
	}
}
