#pragma once

#include "Process.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

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
};

/// Runs the rows; none may leave a file behind that was not there.
inline void RunRows(const std::vector<VRow>& i_rRows, const VScratchFolder& i_rFolder)
{
	for (const VRow& rRow : i_rRows)
	{
		SCOPED_TRACE(rRow.m_pName);
		const std::vector<std::string> before = i_rFolder.Names();
		const VRun run = RunRetarget(rRow.m_Arguments, i_rFolder.Path());
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

inline std::string Data(const std::string& i_rName)
{
	return RETARGET_TEST_DATA "/" + i_rName;
}

inline const std::string c_Fbx = Data("fbx/own_ns_yup_cm_b7400.fbx");
inline const std::string c_Performer = Data("qrt/performer.qrs");
