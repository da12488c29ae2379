#pragma once

#include "SetupIO/Setup.h"

#include <string>
#include <vector>

namespace SetupIO
{

/// A text that ReadSetup reads back as equal: fields in one order, each pair and edit on a line.
std::string WriteSetup(const VSetup& i_rSetup);

/// How an edit may be written, for the schema.
struct VEditForm
{
	/// Without dashes.
	std::string m_Name;
	bool m_bValue = false;
	std::string m_Help;
};

/// The JSON schema (draft 2020-12) of all texts.
std::string SchemaText(const std::vector<VEditForm>& i_rEdits);

} // namespace SetupIO
