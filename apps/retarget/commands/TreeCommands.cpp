#include "CommandLineText/Messages.h"
#include "CommandLineText/System.h"
#include "retarget/commands/Commands.h"
#include "retarget/subject/Residuals.h"
#include "retarget/subject/SubjectFile.h"
#include "retarget/text/InputFile.h"
#include "retarget/text/Output.h"
#include "retarget/text/Table.h"

#include "CoreOrlexTypes/Fields.h"
#include "CoreOrlexTypesUtils/convert/SubjectParametrisedConverter.h"
#include "FBXIO/FBXReader.h"
#include "SetupProposal/Side.h"

#include <algorithm>
#include <cmath>
#include <unistd.h>

namespace CommandLine
{
namespace
{

/// A bone or a segment.
struct VTreeNode
{
	std::string m_Name;
	/// -1 for a root.
	std::int64_t m_Parent = -1;
	/// Mm from the parent's origin.
	double m_Length = 0.0;
	/// Of segments.
	std::string m_Joint;
	/// Of segments of a retarget subject: what drives it.
	std::vector<std::string> m_Sources;
};

using VTree = std::vector<VTreeNode>;

const char* SideText(const std::string& i_rName)
{
	switch (SetupProposal::SideOfName(i_rName))
	{
	case SetupProposal::ESide::Left: return "left";
	case SetupProposal::ESide::Right: return "right";
	case SetupProposal::ESide::None: break;
	}
	return "";
}

VTree ReadBones(const std::string& i_rPath)
{
	FBXIO::FBXReader reader;
	if (!reader.LoadFile(InputPath(i_rPath).string()) || !reader.IsComplete())
		throw VCommandError(EBadInput, "\"" + i_rPath + "\" could not be read as FBX");
	VTree tree;
	if (!reader.HasSkeleton())
		return tree;
	const FBXIO::VSkinSkeleton& rSkeleton = *reader.GetSkeleton();
	for (const FBXIO::VSkinBone& rBone : rSkeleton)
	{
		VTreeNode& rNode = tree.emplace_back();
		rNode.m_Name = rBone.m_Name;
		rNode.m_Parent = rBone.m_ParentIndex;
		if (rBone.m_ParentIndex < 0)
			continue;
		const auto [x, y, z] = rBone.m_Global.Translation();
		const auto [parentX, parentY, parentZ] = rSkeleton[std::size_t(rBone.m_ParentIndex)].m_Global.Translation();
		rNode.m_Length = std::hypot(x - parentX, y - parentY, z - parentZ);
	}
	return tree;
}

VTree ReadSegments(const std::string& i_rPath)
{
	const CoreOrlexTypes::VSubjectParametrised parametrised = ReadSubjectFile(i_rPath).m_Record.m_SubjectParametrised;
	CoreOrlexTypes::VSubject subject;
	CoreOrlexTypesUtils::SubjectParametrisedConverter::ConvertSubject(parametrised, subject);
	VTree tree;
	// The last segment at each depth.
	std::vector<std::int64_t> last;
	for (std::size_t i = 0; i < parametrised.m_Segments.size(); ++i)
	{
		const auto& rSegment = parametrised.m_Segments[i];
		VTreeNode& rNode = tree.emplace_back();
		rNode.m_Name = rSegment.m_Name;
		// A damaged file may skip a depth.
		const std::size_t depth = std::min<std::size_t>(rSegment.m_TreeDepth, last.size());
		rNode.m_Parent = depth == 0 ? -1 : last[depth - 1];
		last.resize(depth);
		last.push_back(std::int64_t(i));
		if (depth > 0 && i < subject.m_Segments.size())
		{
			const auto& [x, y, z] = subject.m_Segments[i].m_PreTranslation;
			rNode.m_Length = std::hypot(x, y, z);
		}
		rNode.m_Joint = CoreOrlexTypes::EnumeratorName(rSegment.m_Joint.m_JointType);
	}
	for (const auto& rTarget : parametrised.m_Targets)
		for (const std::uint32_t segment : rTarget.m_SegmentIndices)
			if (segment < tree.size())
				for (const std::string& rName : FollowedNames(parametrised, rTarget))
					if (std::vector<std::string>& rSources = tree[segment].m_Sources;
					    std::find(rSources.begin(), rSources.end(), rName) == rSources.end())
						rSources.push_back(rName);
	return tree;
}

void Show(const VTree& i_rTree, bool i_bSegments)
{
	VTable table;
	table.AddColumn("INDEX", VTable::ERight);
	table.AddColumn("NAME", VTable::ELeft);
	table.AddColumn("LENGTH", VTable::ERight);
	table.AddColumn("SIDE", VTable::ELeft);
	if (i_bSegments)
	{
		table.AddColumn("JOINT", VTable::ELeft);
		table.AddColumn("FOLLOWS", VTable::ELeft);
	}
	VJson json = VJson::array();
	std::vector<std::size_t> depths;
	for (const VTreeNode& rNode : i_rTree)
	{
		const std::string index = std::to_string(depths.size());
		depths.push_back(rNode.m_Parent < 0 ? 0 : depths[std::size_t(rNode.m_Parent)] + 1);
		const std::string side = SideText(rNode.m_Name);
		VJson item{{"index", json.size()}, {"name", rNode.m_Name}, {"parent", rNode.m_Parent},
		    {"length", rNode.m_Length}, {"side", side}};
		std::vector<std::string> texts{
		    index, std::string(2 * depths.back(), ' ') + rNode.m_Name, Fixed(rNode.m_Length, 1), side};
		if (i_bSegments)
		{
			item["joint"] = rNode.m_Joint;
			item["follows"] = rNode.m_Sources;
			texts.push_back(rNode.m_Joint);
			std::string sources;
			for (const std::string& rName : rNode.m_Sources)
				sources += (sources.empty() ? "" : ", ") + rName;
			texts.push_back(sources);
		}
		json.push_back(std::move(item));
		table.AddRow(texts);
	}
	PrintResult(json, table.Text(HasColours(STDOUT_FILENO), TerminalWidth()));
}

} // namespace

VCommand AddBonesCommand(CLI::App& io_rProgram)
{
	CLI::App* const pApp = AddCommand(io_rProgram, "bones",
	    "Show the bones of an FBX file as a tree: index, name, length in mm from the parent, and side",
	    {"bones hero.fbx"});
	const auto pFile = std::make_shared<std::string>();
	pApp->add_option("FILE.fbx", *pFile, "FBX file, binary or ASCII; - is standard input")->required();
	return {pApp,
	    [pFile]
	    {
		    Show(ReadBones(*pFile), false);
		    return EFine;
	    }};
}

VCommand AddSegmentsCommand(CLI::App& io_rProgram)
{
	CLI::App* const pApp = AddCommand(io_rProgram, "segments",
	    "Show the segments of a skeleton or retarget file as a tree: index, name, length in mm from the parent, side, "
	    "type "
	    "of joint (Dummy: none), and what it follows by the targets of a retarget subject",
	    {"segments performer.qrs", "segments hero.qrr"});
	const auto pFile = std::make_shared<std::string>();
	pApp->add_option("FILE", *pFile, c_pSkeletonFileHelp)->required();
	return {pApp,
	    [pFile]
	    {
		    Show(ReadSegments(*pFile), true);
		    return EFine;
	    }};
}

} // namespace CommandLine
