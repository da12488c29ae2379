#pragma once

#include <QAbstractTableModel>
#include <QColor>

#include <optional>
#include <vector>

namespace StudioHost
{

class VTakePlayer;

/// How far each target is off: in the frame that is shown, and over all frames once they are solved.
class VResidualModel : public QAbstractTableModel
{
	Q_OBJECT

public:
	enum EColumn
	{
		EName,
		ESource,
		ETarget,
		ENow,
		ERms,
		EP95,
		EMax,
		EMaxFrame,
		EColumnCount
	};

	explicit VResidualModel(VTakePlayer& i_rPlayer, QObject* i_pParent = nullptr);

	int rowCount(const QModelIndex& i_rParent = {}) const override;
	int columnCount(const QModelIndex& i_rParent = {}) const override;
	QVariant data(const QModelIndex& i_rIndex, int i_Role) const override;
	QVariant headerData(int i_Section, Qt::Orientation i_Orientation, int i_Role) const override;

	bool IsRotation(int i_Row) const { return i_Row < int(m_Rows.size()) && m_Rows[std::size_t(i_Row)].m_bRotation; }
	QString Name(int i_Row) const { return index(i_Row, EName).data().toString(); }
	/// The frame in which a target is furthest off; nothing before it is known.
	std::optional<std::size_t> WorstFrame(int i_Row) const;

private:
	struct VRow
	{
		QString m_Name;
		QString m_Source;
		QString m_Target;
		bool m_bRotation = false;
	};

	void MakeRows();
	/// In mm or radians, as solved; NaN if there is none.
	double Value(int i_Row, int i_Column) const;

	VTakePlayer& m_rPlayer;
	std::vector<VRow> m_Rows;
	/// Of the subject that the rows are of.
	const void* m_pOf = nullptr;
};

/// What is fine, what wants a look, and what is off: in mm, or of rotations radians.
QColor ResidualColour(double i_Residual, bool i_bRotation);

} // namespace StudioHost
