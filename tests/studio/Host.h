#pragma once

#include "../LogRecorder.h"

#include <QCoreApplication>
#include <QDir>
#include <QFile>
#include <QSettings>
#include <QTemporaryDir>

#include <gtest/gtest.h>

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

/// Warnings and errors.
struct VMessages : VLogRecorder
{
	VMessages() : VLogRecorder(NVX::ELogWarning) {}
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
