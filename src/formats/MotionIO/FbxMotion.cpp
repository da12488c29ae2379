#include "MotionIO/FbxMotion.h"

#include "TakeIO/FbxCurve.h"
#include "fbxsdk/container/RecordInsertion.h"
#include "fbxsdk/container/RecordWriter.h"
#include "fbxsdk/container/Values.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <set>

namespace
{

using namespace FbxFormat;
using namespace MotionIO;
using Rotation::VVector3;
using namespace std::string_view_literals;

constexpr std::uint32_t c_FirstVersion = 7000;

/// Degrees, nearer than which a rotation is the file's own.
constexpr double c_SameAngle = 1e-5;

/// Of a curve: straight from key to key, with the format's usual tangents for those who make it a cubic one.
constexpr std::int32_t c_LinearKeys = 0x4;
constexpr float c_Tangents[]{0.0f, 0.0f, 9.419963e-30f, 0.0f};
constexpr std::int32_t c_CurveVersion = 4008;

/// A place or rotation of a bone over all frames.
struct VTrack
{
	std::size_t m_Bone = 0;
	const char* m_pProperty = nullptr;
	const char* m_pName = nullptr;
	/// As the file has it.
	VVector3 m_Own{};
	double m_Same = 0.0;
	std::array<std::vector<float>, 3> m_Values;

	bool IsOwn() const
	{
		for (std::size_t axis = 0; axis < 3; ++axis)
			for (const float value : m_Values[axis])
				if (std::abs(double(value) - m_Own[axis]) > m_Same)
					return false;
		return true;
	}
};

class VFbxMotion
{
public:
	VFbxMotion(const VBones& i_rBones, const TakeIO::VTake& i_rMotion, const VMotionSettings& i_rSettings)
	    : m_rBones(i_rBones), m_rTree(i_rBones.m_Records.Tree()), m_rMotion(i_rMotion), m_rSettings(i_rSettings)
	{
	}

	EPrinted Print(std::string_view i_File, std::string& o_rBytes, std::string& o_rError)
	{
		const auto refuse = [&o_rError](const char* i_pWhy)
		{
			o_rError = i_pWhy;
			return EPrinted::Refused;
		};
		const VFileKind& rKind = m_rBones.m_Records.Kind();
		if (rKind.m_Kind != EFileKind::Binary || rKind.m_Version < c_FirstVersion)
			return refuse("Its file is of the text form or of a version before 7: only binary files of version 7 take "
			              "one more animation stack. Export it again, or write another kind of file");
		VBoneMotion motion(m_rBones, m_rMotion, m_rSettings.m_Scale);
		if (motion.Driven() == 0)
			return refuse("No bone has the name of a joint of the motion");
		if (!Sample(motion))
			return EPrinted::Cancelled;
		Name();
		const bool bFits = InsertRecords(i_File, rKind.m_Version, m_rTree,
		    {{"Objects", [this](VRecordWriter& io_rWriter) { WriteObjects(io_rWriter); }},
		        {"Connections", [this](VRecordWriter& io_rWriter) { WriteConnections(io_rWriter); }},
		        {"Takes", [this](VRecordWriter& io_rWriter) { WriteTake(io_rWriter); }}},
		    o_rBytes);
		if (!bFits)
			return refuse("With the motion its file were larger than is read");
		return EPrinted::Done;
	}

private:
	bool Sample(VBoneMotion& io_rMotion)
	{
		std::vector<VTrack> tracks;
		for (std::size_t bone = 0; bone < m_rBones.m_Joints.size(); ++bone)
		{
			if (!io_rMotion.IsDriven(bone))
				continue;
			const VNodeTransform& rRest = m_rBones.m_Joints[bone].m_Rest;
			tracks.push_back({bone, "Lcl Translation", "T", rRest.m_Translation, c_SamePlace / m_rBones.m_Unit, {}});
			tracks.push_back({bone, "Lcl Rotation", "R", rRest.m_Rotation, c_SameAngle, {}});
		}
		for (std::size_t frame = 0; frame < m_rMotion.m_Frames; ++frame)
		{
			if (m_rSettings.m_Progress && !m_rSettings.m_Progress(double(frame) / double(m_rMotion.m_Frames)))
				return false;
			m_Times.push_back(std::int64_t(std::llround(double(frame) * TakeIO::c_FbxSecond / m_rMotion.m_Rate)));
			io_rMotion.Compute(frame);
			for (std::size_t i = 0; i < tracks.size(); ++i)
			{
				const VNodeTransform& rTransform = io_rMotion.Transform(tracks[i].m_Bone);
				const VVector3& rValue = i % 2 == 0 ? rTransform.m_Translation : rTransform.m_Rotation;
				for (std::size_t axis = 0; axis < 3; ++axis)
					tracks[i].m_Values[axis].push_back(float(rValue[axis]));
			}
		}
		// What stands still has one key.
		for (VTrack& rTrack : tracks)
			if (!rTrack.IsOwn())
			{
				for (std::vector<float>& rValues : rTrack.m_Values)
					if (std::ranges::all_of(rValues, [&](float i_Value) { return i_Value == rValues.front(); }))
						rValues.resize(1);
				m_Tracks.push_back(std::move(rTrack));
			}
		return true;
	}

	/// Numbers that no object has, and a name that no stack has.
	void Name()
	{
		std::set<std::string_view> stacks;
		for (const VObject& rObject : m_rBones.m_Records.Document().Objects())
		{
			m_Taken.insert(ValueAt(m_rTree, rObject.m_Element, 0).AsInteger());
			if (rObject.m_Kind == "AnimationStack")
				stacks.insert(rObject.m_Name);
		}
		m_Stack = NewNumber();
		m_Layer = NewNumber();
		m_Numbers.resize(m_Tracks.size());
		for (std::array<std::int64_t, 4>& rNumbers : m_Numbers)
			for (std::int64_t& rNumber : rNumbers)
				rNumber = NewNumber();
		m_Name = m_rSettings.m_Name;
		for (int i = 2; stacks.contains(m_Name); ++i)
			m_Name = m_rSettings.m_Name + ' ' + std::to_string(i);
	}

	std::int64_t NewNumber()
	{
		while (!m_Taken.insert(++m_LastNumber).second)
		{
		}
		return m_LastNumber;
	}

	std::string FullName(std::string_view i_Name, std::string_view i_Class) const
	{
		return std::string(i_Name).append("\0\1"sv).append(i_Class);
	}

	void WriteObjects(VRecordWriter& io_rWriter) const
	{
		const std::string stack = FullName(m_Name, "AnimStack");
		io_rWriter.Open("AnimationStack", {m_Stack, std::string_view(stack), ""sv});
		io_rWriter.Open("Properties70");
		for (const std::string_view property : {"LocalStop"sv, "ReferenceStop"sv})
			io_rWriter.Add("P", {property, "KTime"sv, "Time"sv, ""sv, m_Times.back()});
		io_rWriter.Close();
		io_rWriter.Close();
		const std::string layer = FullName("BaseLayer", "AnimLayer");
		io_rWriter.Open("AnimationLayer", {m_Layer, std::string_view(layer), ""sv});
		io_rWriter.Close();
		for (std::size_t i = 0; i < m_Tracks.size(); ++i)
			WriteTrack(io_rWriter, m_Tracks[i], m_Numbers[i]);
	}

	/// The numbers are those of the curve node and of its curves.
	void WriteTrack(
	    VRecordWriter& io_rWriter, const VTrack& i_rTrack, const std::array<std::int64_t, 4>& i_rNumbers) const
	{
		const std::string node = FullName(i_rTrack.m_pName, "AnimCurveNode");
		io_rWriter.Open("AnimationCurveNode", {i_rNumbers[0], std::string_view(node), ""sv});
		io_rWriter.Open("Properties70");
		for (std::size_t axis = 0; axis < 3; ++axis)
			io_rWriter.Add("P", {c_Components[axis], "Number"sv, ""sv, "A"sv, double(i_rTrack.m_Values[axis].front())});
		io_rWriter.Close();
		io_rWriter.Close();
		for (std::size_t axis = 0; axis < 3; ++axis)
			WriteCurve(io_rWriter, i_rNumbers[axis + 1], i_rTrack.m_Values[axis]);
	}

	void WriteCurve(VRecordWriter& io_rWriter, std::int64_t i_Number, const std::vector<float>& i_rValues) const
	{
		const std::string name = FullName("", "AnimCurve");
		const auto count = std::int32_t(i_rValues.size());
		io_rWriter.Open("AnimationCurve", {i_Number, std::string_view(name), ""sv});
		io_rWriter.Add("Default", {double(i_rValues.front())});
		io_rWriter.Add("KeyVer", {c_CurveVersion});
		io_rWriter.Add("KeyTime", {std::span(m_Times).first(i_rValues.size())});
		io_rWriter.Add("KeyValueFloat", {std::span<const float>(i_rValues)});
		io_rWriter.Add("KeyAttrFlags", {std::span(&c_LinearKeys, 1)});
		io_rWriter.Add("KeyAttrDataFloat", {std::span<const float>(c_Tangents)});
		io_rWriter.Add("KeyAttrRefCount", {std::span(&count, 1)});
		io_rWriter.Close();
	}

	void WriteConnections(VRecordWriter& io_rWriter) const
	{
		io_rWriter.Add("C", {"OO"sv, m_Layer, m_Stack});
		for (std::size_t i = 0; i < m_Tracks.size(); ++i)
		{
			const VTrack& rTrack = m_Tracks[i];
			const std::array<std::int64_t, 4>& rNumbers = m_Numbers[i];
			const std::int64_t model = ValueAt(m_rTree, m_rBones.Object(rTrack.m_Bone).m_Element, 0).AsInteger();
			io_rWriter.Add("C", {"OO"sv, rNumbers[0], m_Layer});
			io_rWriter.Add("C", {"OP"sv, rNumbers[0], model, std::string_view(rTrack.m_pProperty)});
			for (std::size_t axis = 0; axis < 3; ++axis)
				io_rWriter.Add("C", {"OP"sv, rNumbers[axis + 1], rNumbers[0], c_Components[axis]});
		}
	}

	/// Older programs look for the stack's span here.
	void WriteTake(VRecordWriter& io_rWriter) const
	{
		const std::string file = m_Name + ".tak";
		io_rWriter.Open("Take", {std::string_view(m_Name)});
		io_rWriter.Add("FileName", {std::string_view(file)});
		for (const char* pSpan : {"LocalTime", "ReferenceTime"})
			io_rWriter.Add(pSpan, {std::int64_t(0), m_Times.back()});
		io_rWriter.Close();
	}

	static constexpr std::string_view c_Components[]{"d|X", "d|Y", "d|Z"};

	const VBones& m_rBones;
	const VElementTree& m_rTree;
	const TakeIO::VTake& m_rMotion;
	const VMotionSettings& m_rSettings;
	std::vector<std::int64_t> m_Times;
	std::vector<VTrack> m_Tracks;
	/// Of curve node and curves, by track.
	std::vector<std::array<std::int64_t, 4>> m_Numbers;
	std::set<std::int64_t> m_Taken{0};
	std::int64_t m_LastNumber = 1'000'000'000;
	std::int64_t m_Stack = 0;
	std::int64_t m_Layer = 0;
	std::string m_Name;
};

} // namespace

MotionIO::EPrinted MotionIO::PrintFbxMotion(const VBones& i_rBones, std::string_view i_File,
    const TakeIO::VTake& i_rMotion, const VMotionSettings& i_rSettings, std::string& o_rBytes, std::string& o_rError)
{
	return VFbxMotion(i_rBones, i_rMotion, i_rSettings).Print(i_File, o_rBytes, o_rError);
}
