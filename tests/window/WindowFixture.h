#pragma once

#include "Operator.h"

#include "studio/window/StudioWindow.h"

#include <gtest/gtest.h>

#include <QSettings>
#include <QTemporaryDir>

#include <memory>

/// The studio's window with the panel in it, in an empty folder that has the demo's performer and character.
class Window : public testing::Test
{
protected:
	void SetUp() override;

	QString File(const char* i_pName) const { return m_Folder.filePath(i_pName); }
	QByteArray Content(const char* i_pName) const;

	/// What the command line prints.
	QByteArray Run(const QStringList& i_rArguments) const;
	/// What the command line writes for the same edits.
	QByteArray CommandLine(const QStringList& i_rArguments) const;

	/// Chooses the demo's files and creates the target subject.
	void CreateTargetSubject();
	/// Of the rows of a list.
	QStringList Names(const char* i_pList) const;
	int RowOf(const char* i_pList, const char* i_pName) const;
	/// In the lists of source and target.
	void SelectPair(const char* i_pSource, const char* i_pTarget);
	int Targets() const { return m_pOperator->Property("targets", "count").toInt(); }

	QTemporaryDir m_Folder;
	std::unique_ptr<QSettings> m_pSettings;
	std::unique_ptr<StudioHost::VStudioWindow> m_pWindow;
	std::unique_ptr<VOperator> m_pOperator;
};
