#pragma once

#include "../RetargetSetupCore/TestSubjects.h"
#include "../UtilsFileSystem/Folder.h"
#include "InMemoryHost/PluginContext.h"
#include "RetargetSetupDocument/RetargetSetup.h"

#include <gtest/gtest.h>

#include <utility>

/// A document in an in-memory host, and a folder of its own for files.
class VDocumentTest : public testing::Test
{
protected:
	VDocumentTest()
	{
		m_Document.GetChangedSignal().Connect([this] { ++m_Changes; });
		QObject::connect(&m_Document, &VRetargetSetup::commandIgnored,
		    [this](const QString& i_rCommand, const QString& i_rReason)
		    { m_Told += (i_rCommand + ": " + i_rReason).toStdString(); });
	}

	/// What the document has told since of commands that it ignored.
	std::string TakeTold() { return std::exchange(m_Told, {}); }

	std::string File(const char* i_pName) const { return (m_Folder / i_pName).string(); }
	QUrl Url(const char* i_pName) const { return QUrl::fromLocalFile(QString::fromStdString(File(i_pName))); }

	CoreOrlexTypes::VSubjectParametrised Target() const
	{
		CoreOrlexTypes::VSubjectParametrised subject;
		EXPECT_TRUE(m_Document.GetTargetSubject(subject));
		return subject;
	}

	/// A performer and a character of five segments each, with arms on both sides.
	void SetSmallSubjects()
	{
		const auto source =
		    MakeSubject({{"Hips", -1}, {"LeftArm", 0, {"300", "0", "400"}}, {"RightArm", 0, {"-300", "0", "400"}},
		        {"LeftHand", 1, {"250", "0", "0"}}, {"RightHand", 2, {"-250", "0", "0"}}});
		const auto target = MakeSubject({{"pelvis", -1}, {"arm_l", 0, {"150*GlobalScale", "0", "200*GlobalScale"}},
		    {"arm_r", 0, {"-150*GlobalScale", "0", "200*GlobalScale"}}, {"hand_l", 1, {"125*GlobalScale", "0", "0"}},
		    {"hand_r", 2, {"-125*GlobalScale", "0", "0"}}});
		CoreOrlexTypes::VSubjectApplicationData data;
		data.m_SubjectId = RetargetSetup::c_SubjectId;
		data.m_Segments.resize(5);
		m_Document.SetSourceSubject(source, data);
		m_Document.SetTargetSubject(target, data);
		m_Changes = 0;
	}

	VTestFolder m_Folder;
	/// Keeps what the readers tell of our own files out of the tests' output.
	VLogRecorder m_Quiet;
	InMemoryHost::VPluginContext m_Host;
	VRetargetSetup m_Document{m_Host.GetDispatcher(), m_Host.GetFrameFactory(), m_Host.GetItemFactory()};
	int m_Changes = 0;
	std::string m_Told;
};
