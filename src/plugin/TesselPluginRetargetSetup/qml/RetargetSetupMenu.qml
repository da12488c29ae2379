import QtQuick 2.15
import Orlex.Controls 1.0
import TesselQML 1.0

// What can be done with what is selected, at the place where it was asked for.
Item {
	id: root

	property Item panel: null
	property Item sourceList: null
	property Item targetList: null

	visible: false

	function entriesForTargets() {
		return [
			{ text: "Remove target", keys: "Del", reason: panel.targetReason, act: () => panel.removeTarget() },
			frameEntry()
		]
	}
	function entriesForSegments(source) {
		const list = source ? sourceList : targetList
		const index = list.selectedIndex
		const partner = index === -1 ? -1 : FlowScene.PartnerOf(source, index)
		const reason = index === -1 ? panel.countReason(source ? RetargetSetupSelection.sourceSegmentCount
			: RetargetSetupSelection.targetSegmentCount, "segment")
			: partner === -1 ? list.nameOf(index) + " has no partner on the other side." : ""
		return [
			{ text: "Add position target", keys: "Alt+T", reason: panel.addTargetReason, act: () => panel.addTarget(true) },
			{ text: "Add rotation target", keys: "Alt+R", reason: panel.addTargetReason, act: () => panel.addTarget(false) },
			{ text: "Select partner", reason: reason, act: () => panel.run(() => list.show(partner)) },
			frameEntry()
		]
	}
	function frameEntry() {
		return { text: "Frame", keys: "Ctrl+F", act: () => Tessel.execute("Workspace3d:FrameSelected") }
	}
	function listEntry(list, index) {
		return { text: "Show in list", reason: index === -1 ? "Not exactly one is selected." : "", act: () => list.show(index) }
	}

	// What is typed and was selected just before counts.
	function openForTargets(item, x, y) {
		panel.commitField()
		menu.show(item, x, y, entriesForTargets())
	}
	function openForSegments(source, item, x, y) {
		panel.commitField()
		menu.show(item, x, y, entriesForSegments(source))
	}
	// In the view it is for what is pointed at, which is selected then.
	function openForView(item, x, y) {
		const kind = FlowScene.SelectPointedAt()
		panel.commitField()
		if (kind === FlowScene.targetKind)
			return menu.show(item, x, y, entriesForTargets())
		const source = kind === FlowScene.sourceSegmentKind
			|| kind === 0 && RetargetSetupSelection.targetSegmentCount === 0 && sourceList.selectedIndex !== -1
		const list = source ? sourceList : targetList
		menu.show(item, x, y, entriesForSegments(source).concat(listEntry(list, list.selectedIndex)))
	}

	OrlexMenu {
		id: menu
		objectName: "contextMenu"
		onRefused: root.panel.tell(reason)
	}
}
