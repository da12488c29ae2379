import QtQuick 2.15

// Shows and sets target[property], of any object or property map. Without a target, or where the target has no such
// property, it is disabled.
OrlexCheckBox {
	id: box

	property var target: null
	property string property: ""
	readonly property bool bound: target !== null && target !== undefined && property !== ""
		&& target[property] !== undefined

	function shown() {
		return Qt.binding(function() { return bound && !!target[property] })
	}

	enabled: bound
	Component.onCompleted: checked = shown()
	onToggled: {
		target[property] = checked
		// The target has the last word.
		checked = shown()
	}
}
