#pragma once

#include "DebugServices/GlobalLog.h"

#include <QCoreApplication>
#include <QDir>
#include <QFile>
#include <QSettings>
#include <QTemporaryDir>

#include <gtest/gtest.h>

#include <mutex>
#include <string>
#include <vector>

/// Runs all that is queued, and what that queues.
inline void RunEvents()
{
	for (int i = 0; i < 5; ++i)
		QCoreApplication::processEvents();
}

/// Settings in a folder that goes with the test.
struct VScratchSettings
{
	QString Path(const QString& i_rName) const { return m_Folder.filePath(i_rName); }

	QTemporaryDir m_Folder;
	QSettings m_Settings{m_Folder.filePath(QStringLiteral("studio.ini")), QSettings::IniFormat};
};

/// The messages of warnings and errors while it lives, as "category: text".
class VMessages
{
public:
	VMessages()
	    : m_pSink(NVX::GlobalLog::AddSink(
	        [this](const NVX::VLogCategory& i_rCategory, int i_Level, const std::string& i_rText)
	        {
		        const std::lock_guard lock(m_Mutex);
		        if (i_Level <= NVX::ELogWarning)
			        m_Texts += i_rCategory.Name() + ": " + i_rText + "\n";
	        }))
	{
	}
	std::string Take()
	{
		const std::lock_guard lock(m_Mutex);
		return std::exchange(m_Texts, {});
	}

private:
	std::mutex m_Mutex;
	std::string m_Texts;
	const std::shared_ptr<void> m_pSink;
};

inline QByteArray ReadFile(const QString& i_rPath)
{
	QFile file(i_rPath);
	EXPECT_TRUE(file.open(QIODevice::ReadOnly)) << i_rPath.toStdString();
	return file.readAll();
}

inline QString WriteFile(const QString& i_rPath, const QByteArray& i_rBytes)
{
	QFile file(i_rPath);
	EXPECT_TRUE(file.open(QIODevice::WriteOnly)) << i_rPath.toStdString();
	file.write(i_rBytes);
	return i_rPath;
}
