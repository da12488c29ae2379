import QtQuick 2.15
import QtQuick.Dialogs 1.3
import Orlex.Controls 1.0
import TesselQML 1.0

// Asks for files: which one to load, and where to save.
Item {
	id: files

	property Item panel: null

	visible: false

	function load() {
		loadDialog.open()
	}

	function isLegacy(url) {
		return url.toString().endsWith(".qrx")
	}

	// Legacy files are only read: what came from one is saved under a new name.
	function save() {
		if (isLegacy(panel.currentTargetSubjectURL))
			askWhere()
		else
			saveTo(panel.currentTargetSubjectURL)
	}

	function saveTo(url) {
		panel.run(() => ContextRetargetSetup.SaveTargetSubjectURL(url))
	}

	// A file of another extension is one that "Load" does not show. The dialog has only asked about the name that was
	// typed.
	function saveAs(url) {
		if (/\.qr[rx]$/i.test(url))
			return saveTo(url)
		const whole = url + ".qrr"
		if (!contextQuickWidget.IsThere(whole))
			return saveTo(whole)
		replaceDialog.url = whole
		replaceDialog.open()
	}

	function askWhere() {
		saveDialog.open()
	}

	OrlexFileDialog {
		id: loadDialog
		objectName: "loadDialog"
		title: "Choose a file"
		startFolder: ContextRetargetsUrl
		nameFilters: ["Subject files (*.qrr)", "Legacy subject files (*.qrx)"]
		onAccepted: {
			if (fileUrls.length === 1)
				files.panel.run(() => ContextRetargetSetup.LoadTargetSubjectURL(fileUrls[0]))
		}
	}
	OrlexFileDialog {
		id: saveDialog
		objectName: "saveDialog"
		title: "Choose a file"
		startFolder: ContextRetargetsUrl
		nameFilters: ["Subject files (*.qrr)"]
		selectExisting: false
		defaultSuffix: "qrr"
		onAccepted: {
			if (fileUrls.length === 1)
				files.saveAs(fileUrls[0].toString())
		}
	}

	MessageDialog {
		id: replaceDialog

		property string url: ""

		objectName: "replaceDialog"
		title: "Save As"
		icon: StandardIcon.Warning
		text: Tessel.fileName(url) + " is there already. Do you want to replace it?"
		standardButtons: StandardButton.Yes | StandardButton.No
		onYes: files.saveTo(url)
	}
}
