#pragma once

#include <QAbstractListModel>

namespace OrlexGraphics
{

/// The tiles of a camera view, for QML. Views without cameras have no tiles.
class VCameraGrid : public QAbstractListModel
{
	Q_OBJECT
	/// Width of a tile by its height.
	Q_PROPERTY(qreal aspectRatio READ AspectRatio WRITE SetAspectRatio NOTIFY AspectRatioChanged)
	Q_PROPERTY(int count READ Count NOTIFY CountChanged)

public:
	enum ERoles
	{
		tileUserId = Qt::UserRole + 1,
		tileDisplayType,
		tileDeviceURN,
		tileRect,
		tileVideo,
		tileVideoInput,
		tileVideoFile,
		tileSelectionItem,
		tileAdditionalData
	};
	Q_ENUM(ERoles)

	using QAbstractListModel::QAbstractListModel;

	int rowCount(const QModelIndex& i_rParent = {}) const override;
	QVariant data(const QModelIndex& i_rIndex, int i_Role) const override;
	QHash<int, QByteArray> roleNames() const override;

	qreal AspectRatio() const { return m_AspectRatio; }
	void SetAspectRatio(qreal i_AspectRatio);
	int Count() const { return rowCount(); }

	/// Whether pictures of cameras that stand on their side are turned, and by right angles only.
	void SetRotation(bool i_bShowRotated, bool i_bSnap90Degrees);
	bool ShowRotated() const { return m_bShowRotated; }
	bool Snap90Degrees() const { return m_bSnap90Degrees; }

signals:
	void AspectRatioChanged();
	void CountChanged();
	void ResetViews();

private:
	qreal m_AspectRatio = 1.0;
	bool m_bShowRotated = true;
	bool m_bSnap90Degrees = false;
};

} // namespace OrlexGraphics
