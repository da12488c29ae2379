#pragma once

#include <CLI/CLI.hpp>

#include <string>
#include <string_view>
#include <vector>

namespace CommandLine
{

/// Where a command writes its file.
struct VOutput
{
	/// "-" is standard output.
	std::string m_Path;
	/// Replace whatever stands there.
	bool m_bForce = false;
};

/// A kind of file that commands write: how its name ends, and how it begins.
struct VOutputKind
{
	/// With its article.
	const char* m_pName;
	/// In lower case, with the dot.
	std::vector<std::string> m_Extensions;
	/// Whether a file that begins with these bytes is of this kind.
	bool (*m_pBegins)(std::string_view i_Head);
};

/// The four kinds of the skeleton family are one format: only their names tell them apart.
extern const VOutputKind c_RetargetSubjectFile;
extern const VOutputKind c_SkeletonFamilyFile;
extern const VOutputKind c_PerformerFile;
extern const VOutputKind c_DrawingFile;
extern const VOutputKind c_SchemaFile;
extern const VOutputKind c_PictureFile;
/// Presets, recipes and their schema.
extern const VOutputKind c_SetupFile;
extern const VOutputKind c_PageFile;

/// Adds --force.
void AddForceOption(CLI::App& io_rApp, VOutput& io_rOutput);

/// To be called before the work: throws VCommandError with EWrongUsage for a name that does not end as names of the
/// kind do and for an output that is one of these inputs; with EBadOutput for a file of another kind that stands
/// there, unless that is forced. An empty file may always be replaced, and what is no regular file is left to the
/// save to refuse.
void CheckOutput(const VOutput& i_rOutput, const VOutputKind& i_rKind, const std::vector<std::string>& i_rInputs = {});

/// Writes a text, to standard output if the path is "-". Throws VCommandError with EBadOutput if that fails, and where
/// an error has been told or --strict forbids it; a file that stood there then stays.
void WriteText(const std::string& i_rText, const std::string& i_rPath);

/// The extension of a path in lower case, with the dot.
std::string LowerExtension(const std::string& i_rPath);

} // namespace CommandLine
