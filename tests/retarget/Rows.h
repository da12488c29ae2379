#pragma once

#include "Process.h"

#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

using VJson = nlohmann::json;

/// One run of the program in a scratch folder, and what has to come of it.
struct VRow
{
	const char* m_pName;
	std::vector<std::string> m_Arguments;
	int m_Status;
	/// Has to stand in what is printed; empty for no output at all.
	std::string m_Out;
	/// The same of the messages.
	std::string m_Err;
	/// On standard input.
	std::string m_Input = "/dev/null";
};

/// Runs the rows; none may leave a file behind that was not there.
inline void RunRows(const std::vector<VRow>& i_rRows, const VScratchFolder& i_rFolder = {})
{
	for (const VRow& rRow : i_rRows)
	{
		SCOPED_TRACE(rRow.m_pName);
		const std::vector<std::string> before = i_rFolder.Names();
		const VRun run = i_rFolder.Run(rRow.m_Arguments, rRow.m_Input);
		EXPECT_EQ(run.m_Status, rRow.m_Status) << run.m_Err;
		if (rRow.m_Out.empty())
			EXPECT_EQ(run.m_Out, "");
		else
			EXPECT_NE(run.m_Out.find(rRow.m_Out), std::string::npos) << run.m_Out;
		if (rRow.m_Err.empty())
			EXPECT_EQ(run.m_Err, "");
		else
			EXPECT_NE(run.m_Err.find(rRow.m_Err), std::string::npos) << run.m_Err;
		EXPECT_EQ(i_rFolder.Names(), before);
	}
}

/// The JSON that a run prints.
inline VJson RunJson(const std::vector<std::string>& i_rArguments, const VScratchFolder& i_rFolder)
{
	const VRun run = i_rFolder.Run(i_rArguments);
	EXPECT_EQ(run.m_Status, 0) << run.m_Err;
	return VJson::parse(run.m_Out, nullptr, false);
}

/// The file's text with a part of it replaced, which must be there.
inline std::string Replaced(const std::string& i_rPath, const std::string& i_rFrom, const std::string& i_rTo)
{
	std::string text = Get(i_rPath);
	const std::size_t at = text.find(i_rFrom);
	EXPECT_NE(at, std::string::npos) << i_rFrom;
	return at == std::string::npos ? text : text.replace(at, i_rFrom.size(), i_rTo);
}

inline std::string Data(const std::string& i_rName)
{
	return RETARGET_TEST_DATA "/" + i_rName;
}

inline const std::string c_Fbx = Data("fbx/own_ns_yup_cm_b7400.fbx");
inline const std::string c_Performer = Data("qrt/performer.qrs");
