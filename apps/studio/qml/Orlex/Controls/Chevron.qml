import QtQuick 2.15
import Orlex.Theme 1.0

// A small arrow head that points right; turn it to point elsewhere.
Item {
	id: chevron

	property color ink: Theme.windowText

	implicitWidth: 10
	implicitHeight: 10

	Repeater {
		model: 2
		Rectangle {
			x: 3
			y: 4.25
			width: 5.5
			height: 1.5
			radius: 0.75
			color: chevron.ink
			antialiasing: true
			transformOrigin: Item.Right
			rotation: index === 0 ? 45 : -45
		}
	}
}
