#include "CoreOrlexQRTIO/Writer.h"

#include "CoreOrlexQRTIO/FormatVersions.h"
#include "CoreOrlexQRTIO/Limits.h"
#include "CoreOrlexQRTIO/format/EnumTables.h"
#include "CoreOrlexQRTIO/format/FormatTable.h"
#include "CoreOrlexQRTIO/values/ExpressionList.h"
#include "CoreOrlexQRTIO/write/AttributeWriting.h"
#include "CoreOrlexQRTIO/write/WriteSections.h"
#include "CoreOrlexTypes/JointType.h"
#include "CoreOrlexTypesUtils/convert/StaticExpressionParser.h"
#include "DebugServices/GlobalLog.h"
#include "NVX/Status.h"
#include "UtilsFileSystem/SaveFile.h"

#include <boost/format.hpp>

#include <locale>

namespace CoreOrlexQRTIO
{
namespace
{

using CoreOrlexTypes::VSubjectApplicationData;
using CoreOrlexTypes::VSubjectParametrised;
using UtilsRapidXml::VWriterNode;

/// Where the schema of the format is published.
constexpr std::string_view c_SchemaInstance = "http://www.w3.org/2001/XMLSchema-instance";
constexpr std::string_view c_SchemaLocation = "Orlex_QRT_Schema.xsd";

const std::string* NameOf(VWriterNode& io_rNode, VWriting& io_rWriting, const auto& i_rElements,
    const std::vector<std::uint32_t>& i_rFirst, std::uint32_t i_Index, const char* i_pKind)
{
	if (i_Index >= i_rElements.size())
	{
		io_rNode.AddError((boost::format("%1% element refers to %2% %3%, which does not exist.", std::locale::classic())
		    % io_rNode.GetName() % i_pKind % i_Index)
		                      .str());
		return nullptr;
	}
	const std::string& rName = i_rElements[i_Index].m_Name;
	if (i_rFirst[i_Index] != i_Index)
		io_rWriting.m_Warnings.push_back(
		    (boost::format("%1% element refers to %2% %3%, but a reader finds %2% %4%, which has the same name '%5%'.",
		         std::locale::classic())
		        % io_rNode.GetName() % i_pKind % i_Index % i_rFirst[i_Index] % rName)
		        .str());
	return &rName;
}

void WriteModel(VWriterNode& io_rNode, VWriting& io_rWriting)
{
	namespace Table = Format::KinematicModel;
	const VSubjectApplicationData& rApplicationData = io_rWriting.m_rApplicationData;
	WriteText(io_rNode, Table::c_Model, io_rWriting.m_rSubject.m_Model);
	WriteRaw(io_rNode, Table::c_Version, ToText(io_rWriting.m_Version));
	WriteText(io_rNode, Table::c_ModelVersion, io_rWriting.m_rSubject.m_ModelVersion);
	WriteText(io_rNode, Table::c_RetargetSourceTemplate, rApplicationData.m_RetargetSourceTemplate);
	WriteText(io_rNode, Table::c_RetargetSourceSubject, rApplicationData.m_RetargetSourceSubject);
	io_rNode.WriteAttribute("xmlns:xsi", c_SchemaInstance);
	io_rNode.WriteAttribute("xsi:noNamespaceSchemaLocation", c_SchemaLocation);

	const auto section = [&](const Format::VElement& i_rElement, void (*i_pFunction)(VWriterNode&, VWriting&))
	{ WriteElement(io_rNode, i_rElement, [&](VWriterNode& io_rSection) { i_pFunction(io_rSection, io_rWriting); }); };
	section(Table::c_Parameters, WriteParameters);
	section(Table::c_Skeleton, WriteSkeleton);
	section(Table::c_MarkerSet, WriteMarkerSet);
	section(Table::c_TargetSet, WriteTargetSet);
	section(Table::c_Skin, WriteSkin);
	WriteSubspaces(io_rNode, io_rWriting);
}

bool Fits(const VSubjectParametrised& i_rSubject, const VSubjectQRTExtras::VDynamicSubspace& i_rSubspace)
{
	std::size_t size = 0;
	for (const std::string& rJoint : i_rSubspace.m_JointNames)
	{
		const auto segment = std::ranges::find_if(i_rSubject.m_Segments,
		    [&](const VSubjectParametrised::VSegment& i_rSegment) { return i_rSegment.m_Joint.m_Name == rJoint; });
		if (segment == i_rSubject.m_Segments.end())
			return false;
		size += CoreOrlexTypes::StateSize(segment->m_Joint.m_JointType);
	}
	return size == i_rSubspace.m_JointParamsMean.size();
}

void WriteSubspace(VWriterNode& io_rNode, const VSubjectQRTExtras::VDynamicSubspace& i_rSubspace)
{
	namespace Table = Format::Subspace;
	WriteText(io_rNode, Table::c_Name, i_rSubspace.m_Name);
	WriteText(io_rNode, Table::c_Version, i_rSubspace.m_Version);
	std::string names;
	for (const std::string& rName : i_rSubspace.m_JointNames)
	{
		if (!names.empty())
			names += ' ';
		names += rName;
	}
	WriteText(io_rNode, Table::c_JointNames, names);
	WriteReals(io_rNode, Table::c_JointParamsMean, i_rSubspace.m_JointParamsMean);
	for (const VSubjectQRTExtras::VPrincipalComponent& rComponent : i_rSubspace.m_Components)
		WriteElement(io_rNode, Table::c_PrincipalComponent,
		    [&](VWriterNode& io_rComponent)
		    {
			    namespace ComponentTable = Format::PrincipalComponent;
			    WriteText(io_rComponent, ComponentTable::c_Name, rComponent.m_Name);
			    WriteReals(io_rComponent, ComponentTable::c_JointParams, rComponent.m_JointParams);
			    WriteReal(io_rComponent, ComponentTable::c_SqrtEigenvalue, rComponent.m_SqrtEigenvalue);
			    WriteReal(io_rComponent, ComponentTable::c_LowerBound, rComponent.m_LowerBound);
			    WriteReal(io_rComponent, ComponentTable::c_UpperBound, rComponent.m_UpperBound);
			    WriteReal(io_rComponent, ComponentTable::c_TemporalDerivativeSd, rComponent.m_TemporalDerivativeSd);
		    });
}

} // namespace

const std::string* NameOfSegment(VWriterNode& io_rNode, VWriting& io_rWriting, std::uint32_t i_Index)
{
	return NameOf(
	    io_rNode, io_rWriting, io_rWriting.m_rSubject.m_Segments, io_rWriting.m_FirstSegments, i_Index, "segment");
}

const std::string* NameOfMarker(VWriterNode& io_rNode, VWriting& io_rWriting, std::uint32_t i_Index)
{
	return NameOf(
	    io_rNode, io_rWriting, io_rWriting.m_rSubject.m_Markers, io_rWriting.m_FirstMarkers, i_Index, "marker");
}

void WriteColourOrCount(VWriterNode& io_rNode, VWriting& io_rWriting, const Format::VAttribute& i_rAttribute,
    const CoreOrlexTypes::VColour& i_rColour)
{
	io_rWriting.m_CountOfLostColours += i_rColour == CoreOrlexTypes::c_ColourZero;
	WriteColour(io_rNode, i_rAttribute, i_rColour);
}

void WriteParameters(VWriterNode& io_rNode, VWriting& io_rWriting)
{
	// Texts lose blanks at their ends, and then the expressions that use the name would not find it.
	const auto checkName = [&](const std::string& i_rName)
	{
		if (Trimmed(i_rName) != i_rName)
			io_rNode.AddError((boost::format("Parameter '%1%' has blanks at the ends of its name.") % i_rName).str());
	};
	for (const VSubjectParametrised::VStaticParameter& rParameter : io_rWriting.m_rSubject.m_StaticParameters)
		checkName(rParameter.m_Name);
	for (const VSubjectParametrised::VDynamicParameter& rParameter : io_rWriting.m_rSubject.m_DynamicParameters)
		checkName(rParameter.m_Name);
	for (const VSubjectParametrised::VStaticParameter& rParameter : io_rWriting.m_rSubject.m_StaticParameters)
		WriteElement(io_rNode, Format::Parameters::c_StaticParameter,
		    [&](VWriterNode& io_rParameter)
		    {
			    namespace Table = Format::StaticParameter;
			    WriteText(io_rParameter, Table::c_Name, rParameter.m_Name);
			    WriteRealIfSet(io_rParameter, Table::c_Value, rParameter.m_UserValue);
			    WriteRealIfSet(io_rParameter, Table::c_Prior, rParameter.m_Prior);
			    WriteText(io_rParameter, Table::c_Expression, rParameter.m_DefaultExpression);
			    WriteBool(io_rParameter, Table::c_Hidden, !rParameter.m_Visible);
			    WriteBool(io_rParameter, Table::c_Advanced, rParameter.m_Advanced);
			    WriteBool(io_rParameter, Table::c_ReadOnly, rParameter.m_ReadOnly);
			    WriteBool(io_rParameter, Table::c_Required, rParameter.m_Required);
			    WriteEnum(io_rParameter, Table::c_Quantity, EnumTables::Quantity(), rParameter.m_Quantity);
		    });
	for (const VSubjectParametrised::VDynamicParameter& rParameter : io_rWriting.m_rSubject.m_DynamicParameters)
		WriteElement(io_rNode, Format::Parameters::c_Parameter,
		    [&](VWriterNode& io_rParameter)
		    {
			    namespace Table = Format::Parameter;
			    WriteText(io_rParameter, Table::c_Name, rParameter.m_Name);
			    WriteReal(io_rParameter, Table::c_Value, rParameter.m_Value);
			    WriteReal(io_rParameter, Table::c_Prior, rParameter.m_Prior);
			    WriteReal(io_rParameter, Table::c_StandardDeviation, rParameter.m_StandardDeviation);
			    WriteBool(io_rParameter, Table::c_Hidden, !rParameter.m_Visible);
		    });
}

void WriteSkin(VWriterNode& io_rNode, VWriting& io_rWriting)
{
	WriteText(io_rNode, Format::Skin::c_Name, io_rWriting.m_rApplicationData.m_Skin);
	WriteColour(io_rNode, Format::Skin::c_ColourA, io_rWriting.m_rApplicationData.m_SkinColourA);
	WriteColour(io_rNode, Format::Skin::c_ColourB, io_rWriting.m_rApplicationData.m_SkinColourB);
}

void WriteSubspaces(VWriterNode& io_rNode, VWriting& io_rWriting)
{
	std::vector<const VSubjectQRTExtras::VDynamicSubspace*> fitting;
	for (const VSubjectQRTExtras::VDynamicSubspace& rSubspace : io_rWriting.m_rExtras.m_DynamicSubspaces)
		if (Fits(io_rWriting.m_rSubject, rSubspace))
			fitting.push_back(&rSubspace);
		else
			io_rWriting.m_Warnings.push_back(
			    (boost::format("Dynamic subspace '%1%' does not fit the joints any more: it is not written.")
			        % rSubspace.m_Name)
			        .str());
	if (!fitting.empty())
		WriteElement(io_rNode, Format::KinematicModel::c_SubjectDynamicSubspace,
		    [&](VWriterNode& io_rSection)
		    {
			    for (const auto* const pSubspace : fitting)
				    WriteElement(io_rSection, Format::Subspace::c_PcaControlledParams,
				        [&](VWriterNode& io_rSubspace) { WriteSubspace(io_rSubspace, *pSubspace); });
		    });
}

bool VWriter::WriteText(const VSubjectParametrised& i_rSubject, const VSubjectApplicationData& i_rApplicationData,
    const VSubjectQRTExtras& i_rExtras, std::uint32_t i_VersionValue, std::string& o_rText,
    std::vector<std::string>& o_rErrors, std::vector<std::string>& o_rWarnings)
{
	o_rText.clear();
	o_rErrors.clear();
	if (i_VersionValue == c_AutomaticVersion)
		i_VersionValue = LowestVersionValue(i_rSubject, i_rApplicationData, i_rExtras);
	CoreOrlexTypesUtils::VDynamicExpressionParserSimple parser;
	VWriting writing{i_rSubject, i_rApplicationData, i_rExtras, parser, VersionFromValue(i_VersionValue)};
	if (Prepare(writing, o_rErrors))
	{
		// What a segment with all statistics, its marker and its target take: the text grows no more where it is large.
		constexpr std::size_t c_BytesOfSegment = 4096;
		o_rText.reserve(c_BytesOfSegment * i_rSubject.m_Segments.size());
		VWriterNode root(o_rText);
		root.SetVersion(writing.m_Version);
		WriteElement(
		    root, Format::KinematicModel::c_Element, [&](VWriterNode& io_rModel) { WriteModel(io_rModel, writing); });
		if (writing.m_CountOfLostColours > 0)
			writing.m_Warnings.push_back(
			    (boost::format("Black with opacity 0 is no colour that a file can hold: %1% of the subject's colours "
			                   "come back as the default one.",
			         std::locale::classic())
			        % writing.m_CountOfLostColours)
			        .str());
		o_rErrors = root.GetGlobalInfo()->m_Errors.GetTexts();
		if (o_rErrors.empty())
			o_rText += '\n';
		else
			o_rText.clear();
		if (o_rText.size() > c_MaximumFileSize)
		{
			o_rErrors.push_back((boost::format("The file would be larger than the %1% bytes that are read at most.",
			                         std::locale::classic())
			    % c_MaximumFileSize)
			                        .str());
			o_rText.clear();
		}
	}
	o_rWarnings = std::move(writing.m_Warnings);
	return o_rErrors.empty();
}

std::uint32_t VWriter::Write(const boost::filesystem::path& i_rPath, const VSubjectParametrised& i_rSubject,
    const VSubjectApplicationData& i_rApplicationData, const VSubjectQRTExtras& i_rExtras, std::uint32_t i_VersionValue,
    std::vector<std::string>* o_pErrors, const std::function<bool(const std::string& i_rText)>& i_rMayStand)
{
	std::string text;
	std::vector<std::string> errors;
	std::vector<std::string> warnings;
	const bool bWhole = WriteText(i_rSubject, i_rApplicationData, i_rExtras, i_VersionValue, text, errors, warnings);
	const bool bStands = bWhole && (!i_rMayStand || i_rMayStand(text));
	if (bStands)
	{
		std::string reason;
		const std::uint32_t status = UtilsFileSystem::SaveFile(i_rPath, text, reason);
		if (status == NVX::Status::c_FileNotOpened)
			errors.push_back((boost::format("Error opening file '%1%' for writing") % i_rPath.string()).str());
		if (status != NVX::Status::c_Success)
			errors.push_back(reason);
	}
	for (const std::string& rWarning : warnings)
		NVX_LOG("QRTIO", NVX::ELogWarning, "%1%", rWarning);
	if (o_pErrors)
		*o_pErrors = errors;
	else
		for (const std::string& rError : errors)
			NVX_LOG("QRTIO", NVX::ELogError, "%1%", rError);
	return bStands && errors.empty() ? NVX::Status::c_Success : NVX::Status::c_WriteFailure;
}

} // namespace CoreOrlexQRTIO
