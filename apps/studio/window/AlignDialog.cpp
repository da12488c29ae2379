#include "studio/window/AlignDialog.h"

#include "studio/panel/RetargetPanel.h"
#include "studio/window/Named.h"

#include <QCheckBox>
#include <QDialogButtonBox>
#include <QHBoxLayout>
#include <QHeaderView>
#include <QLabel>
#include <QPushButton>
#include <QTableWidget>
#include <QVBoxLayout>

#include <utility>

namespace StudioHost
{

VAlignDialog::VAlignDialog(VRetargetPanel& i_rPanel, QWidget* i_pParent)
    : QDialog(i_pParent), m_rPanel(i_rPanel),
      m_pTable(Named(new QTableWidget(0, 5), "AlignedJoints", tr("Angles before and after"))),
      m_pNote(Named(new QLabel, "AlignNote", tr("What was done")))
{
	Named(this, "AlignToSource", tr("Align to source"));
	setWindowTitle(tr("Align to Source"));
	setAttribute(Qt::WA_DeleteOnClose);
	m_pTable->setHorizontalHeaderLabels({tr("Target"), tr("Source"), tr("Before"), tr("After"), tr("Note")});
	m_pTable->setEditTriggers(QAbstractItemView::NoEditTriggers);
	m_pTable->setSelectionMode(QAbstractItemView::NoSelection);
	m_pTable->verticalHeader()->hide();
	m_pTable->horizontalHeader()->setStretchLastSection(true);
	m_pNote->setWordWrap(true);

	auto* const pChains = new QHBoxLayout;
	// In the order of the document's command.
	for (const auto& [pName, rText] : {std::pair("AlignSpine", tr("&Spine")), {"AlignArms", tr("&Arms")},
	         {"AlignLegs", tr("&Legs")}, {"AlignOthers", tr("&Others")}})
	{
		auto* const pBox = Named(new QCheckBox(rText), pName, QString(rText).remove('&'));
		pBox->setChecked(true);
		connect(pBox, &QCheckBox::toggled, this, &VAlignDialog::Align);
		pChains->addWidget(pBox);
		m_Chains.push_back(pBox);
	}
	pChains->addStretch();
	auto* const pButtons = Named(
	    new QDialogButtonBox(QDialogButtonBox::Ok | QDialogButtonBox::Cancel), "AlignButtons", tr("Keep or leave"));
	Named(pButtons->button(QDialogButtonBox::Ok), "AlignKeep", tr("Keep this pose"))->setText(tr("&Keep This Pose"));
	Named(pButtons->button(QDialogButtonBox::Cancel), "AlignCancel", tr("Cancel"));
	connect(pButtons, &QDialogButtonBox::accepted, this, &QDialog::accept);
	connect(pButtons, &QDialogButtonBox::rejected, this, &QDialog::reject);
	// Another edit keeps what it was made on; Undo takes it back.
	connect(&m_rPanel, &VRetargetPanel::stateChanged, this,
	    [this]
	    {
		    if (!m_bAtWork && !m_rPanel.IsAligning())
			    close();
	    });
	auto* const pLayout = new QVBoxLayout(this);
	pLayout->addLayout(pChains);
	pLayout->addWidget(m_pTable, 1);
	pLayout->addWidget(m_pNote);
	pLayout->addWidget(pButtons);
	resize(560, 480);
}

bool VAlignDialog::Align()
{
	QVariantList chains;
	for (const QCheckBox* const pBox : m_Chains)
		chains << pBox->isChecked();
	m_bAtWork = true;
	const QVariantMap aligned = m_rPanel.AlignToSource(chains);
	m_bAtWork = false;
	const QVariantList joints = aligned["joints"].toList();
	m_pTable->setRowCount(joints.size());
	for (int row = 0; row < joints.size(); ++row)
	{
		const QVariantMap joint = joints[row].toMap();
		const QString texts[] = {joint["target"].toString(), joint["source"].toString(),
		    QString::number(joint["before"].toDouble(), 'f', 1), QString::number(joint["after"].toDouble(), 'f', 1),
		    joint["note"].toString()};
		for (int column = 0; column < 5; ++column)
			m_pTable->setItem(row, column, new QTableWidgetItem(texts[column]));
	}
	m_pTable->resizeColumnsToContents();
	QStringList notes{tr(
	    "Degrees between the directions of segments. Turned by %1 degrees as a whole, moved by %2 mm along the floor, "
	    "lifted by %3 mm.")
	                      .arg(aligned["turn"].toDouble(), 0, 'f', 1)
	                      .arg(aligned["move"].toDouble(), 0, 'f', 1)
	                      .arg(aligned["lift"].toDouble(), 0, 'f', 1)};
	for (const QVariant& rRefused : aligned["refused"].toList())
		notes << rRefused.toString();
	m_pNote->setText(notes.join('\n'));
	return !aligned.isEmpty();
}

void VAlignDialog::done(int i_Result)
{
	m_bAtWork = true;
	m_rPanel.EndAlignment(i_Result == Accepted);
	QDialog::done(i_Result);
}

} // namespace StudioHost
