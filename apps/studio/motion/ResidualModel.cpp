#include "studio/motion/ResidualModel.h"

#include "CoreOrlexTypes/SubjectApplicationData.h"
#include "TakeSolve/TargetWords.h"
#include "math/VisibleText.h"
#include "studio/motion/TakePlayer.h"

#include <cmath>
#include <limits>
#include <numbers>

using TesselPluginInterface::ItemValue;

namespace StudioHost
{
namespace
{

constexpr double c_NotANumber = std::numeric_limits<double>::quiet_NaN();
constexpr double c_Degrees = 180.0 / std::numbers::pi;

// An eye sees a hand that is off by the width of a finger, and a head that is turned by some degrees.
constexpr double c_FineMillimetres = 10.0;
constexpr double c_BadMillimetres = 30.0;
constexpr double c_FineAngle = 5.0 / c_Degrees;
constexpr double c_BadAngle = 15.0 / c_Degrees;

const QColor c_Fine(0x7fbf7f);
const QColor c_Middling(0xe0ad4b);
const QColor c_Bad(0xe05a4b);

struct VColumn
{
	const char* m_pTitle;
	const char* m_pToolTip;
};

constexpr VColumn c_Columns[VResidualModel::EColumnCount] = {{QT_TRANSLATE_NOOP("Studio", "Target"), ""},
    {QT_TRANSLATE_NOOP("Studio", "Follows"), ""}, {QT_TRANSLATE_NOOP("Studio", "On"), ""},
    {QT_TRANSLATE_NOOP("Studio", "Now"), "In the frame that is shown"}, {"RMS", "Root mean square over all frames"},
    {"P95", "No more than a twentieth of the frames exceed it"},
    {QT_TRANSLATE_NOOP("Studio", "Worst"), "Over all frames"},
    {QT_TRANSLATE_NOOP("Studio", "In frame"), "Click to look at it"}};

} // namespace

QColor ResidualColour(double i_Residual, bool i_bRotation)
{
	if (i_Residual <= (i_bRotation ? c_FineAngle : c_FineMillimetres))
		return c_Fine;
	return i_Residual <= (i_bRotation ? c_BadAngle : c_BadMillimetres) ? c_Middling : c_Bad;
}

VResidualModel::VResidualModel(VTakePlayer& i_rPlayer, QObject* i_pParent)
    : QAbstractTableModel(i_pParent), m_rPlayer(i_rPlayer)
{
	const auto changed = [this](int i_First, int i_Last)
	{
		if (!m_Rows.empty())
			emit dataChanged(index(0, i_First), index(int(m_Rows.size()) - 1, i_Last));
	};
	connect(&m_rPlayer, &VTakePlayer::solvedChanged, this,
	    [this, changed]
	    {
		    MakeRows();
		    changed(ENow, EMaxFrame);
	    });
	connect(&m_rPlayer, &VTakePlayer::takeChanged, this, &VResidualModel::MakeRows);
	connect(&m_rPlayer, &VTakePlayer::pictureChanged, this, [changed] { changed(ENow, ENow); });
	connect(&m_rPlayer, &VTakePlayer::stateChanged, this, [changed] { changed(ENow, ENow); });
}

void VResidualModel::MakeRows()
{
	const auto pTarget = m_rPlayer.Take() ? m_rPlayer.Target() : nullptr;
	if (m_pOf == pTarget.get())
		return;
	m_pOf = pTarget.get();
	std::vector<VRow> rows;
	if (pTarget)
	{
		const auto pSubject = ItemValue<CoreOrlexTypes::VSubject>(m_rPlayer.Document()->Item("FlowSubjectForSolving"));
		const auto pData = ItemValue<CoreOrlexTypes::VSubjectApplicationData>(
		    m_rPlayer.Document()->Item("FlowSubjectApplicationDataForSolving"));
		for (std::size_t i = 0; pSubject && i < pSubject->m_Targets.size(); ++i)
		{
			const auto& rTarget = pSubject->m_Targets[i];
			const auto shown = [](const std::string& i_rName)
			{ return QString::fromStdString(VisibleText::Of(i_rName)); };
			rows.push_back({pData && i < pData->m_Targets.size() ? shown(pData->m_Targets[i].m_Name) : QString(),
			    shown(TakeSolve::SourceOf(*pSubject, rTarget)), shown(TakeSolve::TargetOf(*pSubject, rTarget)),
			    TakeSolve::IsRotationTarget(rTarget)});
		}
	}
	// A weight is no other list: what is chosen, and where the list stands, stay.
	if (rows.size() == m_Rows.size())
	{
		m_Rows = std::move(rows);
		if (!m_Rows.empty())
			emit dataChanged(index(0, 0), index(int(m_Rows.size()) - 1, EColumnCount - 1));
		return;
	}
	beginResetModel();
	m_Rows = std::move(rows);
	endResetModel();
}

int VResidualModel::rowCount(const QModelIndex& i_rParent) const
{
	return i_rParent.isValid() ? 0 : int(m_Rows.size());
}

int VResidualModel::columnCount(const QModelIndex& i_rParent) const
{
	return i_rParent.isValid() ? 0 : EColumnCount;
}

double VResidualModel::Value(int i_Row, int i_Column) const
{
	const auto row = std::size_t(i_Row);
	if (i_Column == ENow)
	{
		const auto pPicture = m_rPlayer.Picture();
		return m_rPlayer.IsShown() && pPicture && row < pPicture->m_Residuals.size() ? pPicture->m_Residuals[row]
		                                                                             : c_NotANumber;
	}
	const auto& rpJudged = m_rPlayer.Judged();
	if (!rpJudged || row >= rpJudged->m_Report.m_Targets.size() || rpJudged->m_Report.m_Targets[row].m_Frames == 0)
		return c_NotANumber;
	const TakeSolve::VTargetQuality& rQuality = rpJudged->m_Report.m_Targets[row];
	return i_Column == ERms ? rQuality.m_Rms : i_Column == EP95 ? rQuality.m_P95 : rQuality.m_Max;
}

std::optional<std::size_t> VResidualModel::WorstFrame(int i_Row) const
{
	if (i_Row < 0 || std::isnan(Value(i_Row, EMax)))
		return std::nullopt;
	return m_rPlayer.Judged()->m_Report.m_Targets[std::size_t(i_Row)].m_MaxFrame;
}

QVariant VResidualModel::data(const QModelIndex& i_rIndex, int i_Role) const
{
	const int row = i_rIndex.row(), column = i_rIndex.column();
	if (!i_rIndex.isValid() || row >= rowCount())
		return {};
	const VRow& rRow = m_Rows[std::size_t(row)];
	if (i_Role == Qt::TextAlignmentRole && column >= ENow)
		return int(Qt::AlignRight | Qt::AlignVCenter);
	if (i_Role == Qt::ForegroundRole && column >= ENow)
	{
		const double value = Value(row, column);
		return std::isnan(value) ? QVariant() : QVariant(ResidualColour(value, rRow.m_bRotation));
	}
	if (i_Role != Qt::DisplayRole)
		return {};
	switch (column)
	{
	case EName: return rRow.m_Name;
	case ESource: return rRow.m_Source;
	case ETarget: return rRow.m_Target;
	case EMaxFrame:
	{
		const std::optional<std::size_t> frame = WorstFrame(row);
		return frame ? QString::number(*frame) : QString();
	}
	default:
		const double value = Value(row, column);
		if (std::isnan(value))
			return QString();
		return rRow.m_bRotation ? QStringLiteral("%1°").arg(c_Degrees * value, 0, 'f', 1)
		                        : QStringLiteral("%1 mm").arg(value, 0, 'f', 1);
	}
}

QVariant VResidualModel::headerData(int i_Section, Qt::Orientation i_Orientation, int i_Role) const
{
	if (i_Orientation != Qt::Horizontal || i_Section < 0 || i_Section >= EColumnCount)
		return {};
	if (i_Role == Qt::DisplayRole)
		return tr(c_Columns[i_Section].m_pTitle);
	return i_Role == Qt::ToolTipRole ? QVariant(tr(c_Columns[i_Section].m_pToolTip)) : QVariant();
}

} // namespace StudioHost

#include "moc_ResidualModel.cpp"
