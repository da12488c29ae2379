import QtQuick 2.15
import QtQuick.Layouts 1.15
import Orlex.Controls 1.0
import Orlex.Tessel.Parameters 1.0
import Orlex.Theme 1.0

// The targets, and the fields of the one that is selected.
ColumnLayout {
	id: targets

	property Item panel: null
	property Item menu: null

	spacing: Theme.spacing

	RetargetSetupTargetTable {
		objectName: "targets"
		Layout.fillWidth: true
		onMenuRequested: targets.menu.openForTargets(item, x, y)
		Keys.onDeletePressed: if (removeTarget.enabled) removeTarget.act()
		emptyText: targets.panel.targetCount === 0
			? "Choose a source skeleton and a target FBX above, then create the target subject."
			: targets.panel.sourceCount === 0 ? "Choose a source skeleton above."
			: "Select one segment in each list on the right, or in the view, where a click with "
			+ "Shift or Ctrl adds to what is selected. Then add a target."
		Layout.fillHeight: true
	}

	OrlexButton {
		id: removeTarget
		objectName: "removeTarget"
		Layout.fillWidth: true
		text: "Remove target"
		toolTip: "Delete the selected target"
		enabled: RetargetSetupSelection.selectedTarget !== -1
		readonly property string disabledReason: targets.panel.targetReason
		onClicked: targets.panel.removeTarget()
	}

	ParameterView {
		id: targetParameters

		// What was typed for one target must not stand at another.
		readonly property int shownTarget: RetargetSetupSelection.selectedTarget

		objectName: "targetParameters"
		Layout.fillWidth: true
		readonly property string disabledReason: targets.panel.targetReason
		enabled: shownTarget !== -1
		// Nothing below or above moves when a rotation target is chosen, which shows less.
		Layout.minimumHeight: 4 * Theme.controlHeight + 3 * Theme.spacing / 2
		hints: ({
			TargetStateExpressionX: targets.panel.lengthHint,
			TargetStateExpressionY: targets.panel.lengthHint,
			TargetStateExpressionZ: targets.panel.lengthHint
		})
		model: targets.panel.targetParametersModel
		onShownTargetChanged: restore()
	}
}
