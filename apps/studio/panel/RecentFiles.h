#pragma once

#include <QObject>
#include <QSettings>
#include <QStringList>

namespace StudioHost
{

/// The ten files that were opened or saved last, the newest first, kept in settings.
class VRecentFiles : public QObject
{
	Q_OBJECT

public:
	static constexpr int c_Count = 10;

	/// @param i_rSettings must outlive this.
	explicit VRecentFiles(QSettings& i_rSettings);

	/// Paths; before one that was opened as a take, though its kind is another, stands c_pAsTake.
	const QStringList& Files() const { return m_Files; }
	static constexpr const char* c_pAsTake = "take:";

	/// Puts a file in front, wherever it stood.
	void Add(const QString& i_rPath);
	void AddTake(const QString& i_rPath);
	void Remove(const QString& i_rPath);
	void Clear();

signals:
	void changed();

private:
	void PutInFront(const QString& i_rFile);
	void Set(QStringList i_Files);

	QSettings& m_rSettings;
	QStringList m_Files;
};

} // namespace StudioHost
