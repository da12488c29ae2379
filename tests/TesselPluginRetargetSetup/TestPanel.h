#pragma once

#include "../LogRecorder.h"
#include "../UtilsFileSystem/Folder.h"
#include "TestHost.h"

#include "RetargetSetupDocument/RetargetSetup.h"
#include "RetargetSetupDocument/RetargetSetupSelection.h"
#include "TesselParameters/Parameter.h"
#include "TesselPluginInterface/IParameterGroup.h"
#include "TesselPluginRetargetSetup/RetargetSetupScene.h"
#include "TesselPluginRetargetSetup/RetargetSetupWidget.h"

#include <QQuickItem>
#include <gtest/gtest.h>

#include <string>

/// The panel in a test host, with a folder for its files. Nothing has been posted that has not run.
class VPanelTest : public testing::Test
{
protected:
	~VPanelTest() override;

	/// Makes the panel, with what is in the store and the preferences then.
	void Open(bool i_bModules = true);

	/// By objectName, wherever it stands in the QML; null, with a failure, if there is none.
	QQuickItem* Item(const QString& i_rObjectName) const;
	QVariant Property(const QString& i_rObjectName, const char* i_pProperty) const;

	/// A parameter of the running panel by its key.
	TesselPluginInterface::IParameter& Parameter(const std::string& i_rKey) const;
	/// As an operator: types a text, and lets the panel follow. Empty, or why it was refused.
	std::string Type(const std::string& i_rKey, const std::string& i_rText);
	std::string Text(const std::string& i_rKey) const { return Parameter(i_rKey).GetValueText(); }

	void Select(std::uint32_t i_Kind, std::uint32_t i_Index);
	void Run() { RunAll(m_Context); }

	/// What was told to the log since the last call, without the category of folders.
	std::string TakeLog() { return m_Log.Take(); }

	CoreOrlexTypes::VSubjectParametrised Target() const;

	/// Of the document, performer and character.
	void OpenDemo();

	const VTestFolder m_Folder;
	VLogRecorder m_Log{NVX::ELogDetail, "Tessel"};
	VTestContext m_Context;
	std::unique_ptr<VTestGui> m_pGui;
	std::shared_ptr<VRetargetSetup> m_pDocument;
	std::shared_ptr<VRetargetSetupSelection> m_pSelection;
	std::shared_ptr<VRetargetSetupScene> m_pScene;
	std::unique_ptr<VRetargetSetupWidget> m_pWidget;
};

inline const std::string c_DemoSource = RETARGET_SOURCE "/demo/performer.qrs";
inline const std::string c_DemoFBX = RETARGET_SOURCE "/demo/character.fbx";
