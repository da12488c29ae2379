import QtQuick 2.15
import Orlex.Controls 1.0

OrlexTableView {
	model: TargetModel
	selectedIndex: RetargetSetupSelection.selectedTarget
	columns: [
		{ role: "sourceSegment", title: "Source", share: 0.25, sides: true },
		{ role: "targetSegment", title: "Target", share: 0.25, sides: true },
		{ role: "targetType", title: "Type", share: 0.25 },
		{ role: "weight", title: "Weight", share: 0.2 }
	]
}
