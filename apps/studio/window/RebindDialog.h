#pragma once

#include <QDialog>
#include <QVariant>

class QCheckBox;

namespace StudioHost
{

class VRetargetPanel;

/// What would become of the set-up with a changed file of its character, or with another performer: what is found under
/// its name or another one, what is new, what changes, and what is lost. Beside the window: it closes when there is
/// another target subject or another source.
class VRebindDialog : public QDialog
{
	Q_OBJECT

public:
	/// @param i_rLook as the document's LookAtRebind gives it, not empty.
	/// @param i_rPanel must outlive the dialog.
	VRebindDialog(VRetargetPanel& i_rPanel, bool i_bPerformer, const QVariantMap& i_rLook, QWidget* i_pParent);

	/// Does it.
	void accept() override;

private:
	VRetargetPanel& m_rPanel;
	const bool m_bPerformer;
	QCheckBox* const m_pMeasure;
};

} // namespace StudioHost
