#pragma once

#include "TestHost.h"

#include "RetargetSetupDocument/RetargetSetup.h"
#include "RetargetSetupDocument/RetargetSetupSelection.h"
#include "TesselParameters/Parameter.h"
#include "TesselPluginInterface/IParameterGroup.h"
#include "TesselPluginRetargetSetup/RetargetSetupScene.h"
#include "TesselPluginRetargetSetup/RetargetSetupWidget.h"

#include <QQuickItem>
#include <boost/filesystem.hpp>
#include <gtest/gtest.h>

#include <string>
#include <vector>

/// The panel in a test host, with a folder for its files. Nothing has been posted that has not run.
class VPanelTest : public testing::Test
{
protected:
	VPanelTest();
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

	/// What was told to the log since the last call, without the category "Tessel" of folders.
	std::string TakeLog();

	CoreOrlexTypes::VSubjectParametrised Target() const;

	/// Of the document, performer and character.
	void OpenDemo();

	const boost::filesystem::path m_Folder =
	    boost::filesystem::temp_directory_path() / boost::filesystem::unique_path("panel-%%%%%%%%");
	VTestContext m_Context;
	std::unique_ptr<VTestGui> m_pGui;
	std::shared_ptr<VRetargetSetup> m_pDocument;
	std::shared_ptr<VRetargetSetupSelection> m_pSelection;
	std::shared_ptr<VRetargetSetupScene> m_pScene;
	std::unique_ptr<VRetargetSetupWidget> m_pWidget;

private:
	std::vector<std::string> m_Log;
	std::shared_ptr<void> m_pLogToken;
};

inline const std::string c_DemoSource = RETARGET_SOURCE "/demo/performer.qrs";
inline const std::string c_DemoFBX = RETARGET_SOURCE "/demo/character.fbx";
