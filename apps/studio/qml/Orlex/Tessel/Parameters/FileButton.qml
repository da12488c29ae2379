import QtQuick 2.15
import Orlex.Controls 1.0
import TesselQML 1.0

// Opens the dialog for a parameter's file access: a folder, a file to save, one or several files to load. Several are
// joined by ";".
OrlexButton {
	id: button

	property var row
	readonly property int access: row && row.parameter.fileAccess !== undefined ? row.parameter.fileAccess : 0
	readonly property int folder: 1
	readonly property int save: 2
	readonly property int loadMultiple: 4
	readonly property alias dialog: dialog.item

	objectName: row ? row.name + "Browse" : ""
	width: 26
	leftPadding: 0
	rightPadding: 0
	text: "\u2026"
	toolTip: access === folder ? "Choose a folder" : access === save ? "Choose a file to save"
		: access === loadMultiple ? "Choose files" : "Choose a file"
	Accessible.name: row ? row.label + ": " + toolTip : ""
	onClicked: {
		dialog.active = true
		const first = row.valueText.split(";")[0]
		dialog.item.startFolder = access === folder ? Tessel.fileUrl(first) : Tessel.folderUrl(first)
		dialog.item.open()
	}

	Loader {
		id: dialog
		active: false
		sourceComponent: OrlexFileDialog {
			title: button.toolTip
			selectFolder: button.access === button.folder
			selectExisting: button.access !== button.save
			selectMultiple: button.access === button.loadMultiple
			nameFilters: button.row.parameter.fileFilter ? button.row.parameter.fileFilter.split(";;") : []
			onAccepted: {
				const urls = button.access === button.loadMultiple ? fileUrls : [fileUrl]
				button.row.commit(Array.from(urls).map(url => Tessel.localPath(url)).join(";"))
			}
		}
	}
}
