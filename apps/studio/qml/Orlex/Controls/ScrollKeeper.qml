import QtQuick 2.15

// Keeps the scroll position of a list view over resets of its model, as far as the new rows reach.
QtObject {
	id: keeper

	property ListView view: null
	readonly property var model: view ? view.model : null
	property var heard: null
	property real kept: 0

	// Connected by hand, and later than the view connects: handlers of a Connections object would run before the view's.
	function listen() {
		forget()
		if (!model || !model.modelReset)
			return
		heard = model
		heard.modelAboutToBeReset.connect(keep)
		heard.modelReset.connect(restore)
	}
	function forget() {
		if (!heard)
			return
		heard.modelAboutToBeReset.disconnect(keep)
		heard.modelReset.disconnect(restore)
		heard = null
	}
	function keep() {
		kept = view.contentY - view.originY
	}
	function restore() {
		view.forceLayout()
		view.contentY = view.originY + Math.max(0, Math.min(kept, view.contentHeight - view.height))
	}

	onModelChanged: Qt.callLater(listen)
	Component.onDestruction: forget()
}
