pragma Singleton
import QtQuick 2.15

// A calm dark theme: greys, orange for what is active, blue for what is chosen.
QtObject {
	readonly property color active: Qt.rgba(231 / 255, 101 / 255, 0, 1)
	readonly property color highlight: Qt.rgba(75 / 255, 120 / 255, 170 / 255, 1)

	// From the ground up.
	readonly property color base: "#1b1d1f"
	readonly property color dark: "#212427"
	readonly property color window: "#2a2d30"
	readonly property color mid: "#34383c"
	readonly property color button: "#3f444a"
	readonly property color border: "#555b62"

	// Rows of lists: what the mouse points at, and what is chosen.
	readonly property color midlight: "#364a60"
	readonly property color light: highlight

	readonly property color text: "#d8dadd"
	readonly property color windowText: "#c3c7cb"
	readonly property color buttonText: "#e3e5e7"
	readonly property color bright: "#ffffff"
	readonly property color disabledText: "#757b82"

	// The active colour as a ground that text can stand on.
	readonly property color activeGround: "#6b3a12"
	readonly property color error: "#f0625a"
	readonly property color warning: "#e0ad4b"

	readonly property int itemHeight: 22
	readonly property int controlHeight: 24
	readonly property int spacing: 6
	readonly property int margin: 8
	readonly property int radius: 3
	readonly property int fontSize: 12
	readonly property int infoToolTipDelay: 500
}
