#pragma once

#include "NVX/ISelectionItem.h"

#include <QDialog>
#include <QVariant>

#include <vector>

class QComboBox;
class QDoubleSpinBox;
class QLabel;
class QPushButton;
class QTableWidget;

namespace TesselPluginInterface
{
class ISelection;
}

namespace StudioHost
{

class VRetargetPanel;

/// Pairs of segments that the document proposes, a row for each segment of the performer, for the operator to judge:
/// with a tick, the segment of the character in a list, score, kinds of targets and reasons. The pair of the row is
/// selected, so that the view shows it; what was selected comes back. Beside the window, not instead of it: it closes
/// when performer or character are others.
class VProposeDialog : public QDialog
{
	Q_OBJECT

public:
	/// @param i_rPanel and the selection must outlive the dialog.
	VProposeDialog(VRetargetPanel& i_rPanel, TesselPluginInterface::ISelection& io_rSelection, QWidget* i_pParent);

	/// Adds the targets of the ticked rows.
	void accept() override;
	void done(int i_Result) override;

private:
	/// Performer and character have the segments that it was opened for.
	bool IsOfTheirs() const;
	void Fill();
	void AddRow(int i_Source, int i_Target, const QString& i_rReason);
	/// What is told of a pair: the proposed one, an alternative, or what the operator has put together.
	QVariantMap PairOf(int i_Source, int i_Target) const;
	QComboBox* BoxOf(int i_Row) const;
	int SourceOf(int i_Row) const;
	bool IsTicked(int i_Row) const;
	void ShowPair(int i_Row, const QString& i_rReason);
	void SelectPair();
	void UpdateNote();
	QVariantList TickedTargets() const;

	VRetargetPanel& m_rPanel;
	TesselPluginInterface::ISelection& m_rSelection;
	const std::vector<NVX::ISelectionItem> m_Before;
	const QStringList m_Sources;
	const QStringList m_Targets;
	QVariantMap m_Proposal;
	QTableWidget* const m_pTable;
	QDoubleSpinBox* const m_pLeastScore;
	QLabel* const m_pFindings;
	QLabel* const m_pNote;
	QPushButton* m_pAdd = nullptr;
};

} // namespace StudioHost
