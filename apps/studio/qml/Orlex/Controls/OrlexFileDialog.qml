import QtQuick 2.15
import QtQuick.Dialogs 1.3

// A file dialog that begins in its start folder, and later where it was left. "folder" alone is forgotten when a dialog
// opens for the first time.
FileDialog {
	property url startFolder
	property bool begins: false

	onStartFolderChanged: begins = startFolder.toString() !== ""
	onVisibleChanged: {
		if (!visible || !begins)
			return
		begins = false
		folder = startFolder
	}
}
