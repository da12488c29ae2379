#pragma once

#include "NVX/ISelectionItem.h"

#include <QDialog>
#include <QVariant>

#include <vector>

class QComboBox;
class QDoubleSpinBox;
class QLabel;
class QLineEdit;
class QPushButton;
class QScrollArea;
class QTableWidget;

namespace TesselPluginInterface
{
class ISelection;
}

namespace StudioHost
{

class VRetargetPanel;

/// Pairs of segments that the document proposes or that a preset has, a row for each segment of the performer, for the
/// operator to judge: with a tick, the segment of the character in a list, score, kinds of targets with their weights,
/// and reasons. The pair of the row is selected, so that the view shows it; what was selected comes back. Beside the
/// window, not instead of it: it closes when performer or character are others.
class VProposeDialog : public QDialog
{
	Q_OBJECT

public:
	/// @param i_rPanel and the selection must outlive the dialog.
	/// @param i_rPresetFolder whose presets are offered; may be empty.
	VProposeDialog(VRetargetPanel& i_rPanel, TesselPluginInterface::ISelection& io_rSelection,
	    const QString& i_rPresetFolder, QWidget* i_pParent);

	/// Adds the targets of the ticked rows.
	void accept() override;
	void done(int i_Result) override;

protected:
	bool eventFilter(QObject* i_pWatched, QEvent* i_pEvent) override;

private:
	/// Performer and character have the segments that it was opened for.
	bool IsOfTheirs() const;
	void ListPresets();
	/// The pairs are others: what is proposed, or a preset.
	void ChooseOrigin();
	void Fill();
	/// Hides the rows whose names have not what is asked for.
	void Filter();
	void AddRow(int i_Source, int i_Target, const QString& i_rReason);
	/// What is told of a pair: the proposed one, an alternative, or what the operator has put together.
	QVariantMap PairOf(int i_Source, int i_Target) const;
	QComboBox* BoxOf(int i_Row) const;
	int SourceOf(int i_Row) const;
	int TargetOf(int i_Row) const;
	bool IsTicked(int i_Row) const;
	/// Of one kind of target, 0 for none.
	double WeightOf(int i_Row, int i_Column) const;
	void ShowPair(int i_Row, const QString& i_rReason);
	void ShowKinds(int i_Row);
	/// Of the rows that are shown.
	void TickAll(bool i_bTicked);
	void SelectPair();
	void ShowDetails();
	void UpdateNote();
	QVariantList TickedTargets() const;

	VRetargetPanel& m_rPanel;
	TesselPluginInterface::ISelection& m_rSelection;
	const std::vector<NVX::ISelectionItem> m_Before;
	const QStringList m_Sources;
	const QStringList m_Targets;
	const QString m_PresetFolder;
	QVariantMap m_Proposal;
	QTableWidget* const m_pTable;
	QComboBox* const m_pOrigin;
	int m_Origin = 0;
	QDoubleSpinBox* const m_pLeastScore;
	QLineEdit* const m_pFilter;
	QLabel* const m_pFindings;
	QScrollArea* const m_pFindingsArea;
	QLabel* const m_pDetails;
	QLabel* const m_pNote;
	QPushButton* m_pAdd = nullptr;
};

} // namespace StudioHost
