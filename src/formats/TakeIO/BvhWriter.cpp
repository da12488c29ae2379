#include "TakeIO/BvhWriter.h"

#include "TakeIO/Axes.h"
#include "math/NumberText.h"

#include <algorithm>
#include <numbers>

namespace
{

using namespace TakeIO;

class VBvhWriter
{
public:
	explicit VBvhWriter(const VTake& i_rTake) : m_rTake(i_rTake), m_Children(i_rTake.m_Joints.size())
	{
		for (std::size_t i = 0; i < m_rTake.m_Joints.size(); ++i)
			if (const std::int32_t parent = m_rTake.m_Joints[i].m_Parent; parent >= 0)
				m_Children[std::size_t(parent)].push_back(i);
	}

	std::string Write()
	{
		m_Text = "HIERARCHY\n";
		for (std::size_t i = 0; i < m_rTake.m_Joints.size(); ++i)
			if (m_rTake.m_Joints[i].m_Parent < 0)
				WriteTree(i);
		m_Text += "MOTION\nFrames: " + std::to_string(m_rTake.m_Frames) + "\nFrame Time: ";
		NumberText::AppendG(m_Text, 1.0 / m_rTake.m_Rate, c_Digits);
		m_Text += '\n';
		for (std::size_t frame = 0; frame < m_rTake.m_Frames; ++frame)
			WriteFrame(frame);
		return std::move(m_Text);
	}

private:
	static constexpr int c_Digits = 12;

	/// A joint, and how many of its children are written.
	struct VOpen
	{
		std::size_t m_Joint;
		std::size_t m_Next = 0;
	};

	/// Without recursion: a chain may be as long as a take has joints.
	void WriteTree(std::size_t i_Root)
	{
		std::vector<VOpen> open;
		const auto begin = [&](std::size_t i_Joint)
		{
			WriteJoint(i_Joint, open.size());
			open.push_back({i_Joint});
		};
		begin(i_Root);
		while (!open.empty())
		{
			VOpen& rOpen = open.back();
			const std::vector<std::size_t>& rChildren = m_Children[rOpen.m_Joint];
			if (rOpen.m_Next < rChildren.size())
				begin(rChildren[rOpen.m_Next++]);
			else
			{
				open.pop_back();
				Line(open.size(), "}\n");
			}
		}
	}

	/// A chain of thousands must not be mostly tabulators.
	void Line(std::size_t i_Depth, std::string_view i_Text)
	{
		m_Text.append(std::min<std::size_t>(i_Depth, 30), '\t').append(i_Text);
	}

	void WriteJoint(std::size_t i_Joint, std::size_t i_Depth)
	{
		const VJoint& rJoint = m_rTake.m_Joints[i_Joint];
		std::string name = rJoint.m_Name;
		std::ranges::replace_if(
		    name, [](char i_Byte) { return i_Byte == '\n' || i_Byte == '\r'; }, ' ');
		Line(i_Depth, i_Depth == 0 ? "ROOT " : "JOINT ");
		m_Text += name + '\n';
		Line(i_Depth, "{\n");
		WriteOffset(i_Depth + 1, rJoint.m_Rest.t);
		m_Order.push_back(i_Joint);
		const bool bTurned = std::ranges::any_of(rJoint.m_Channels, IsRotation);
		m_bAddsTurn.push_back(!bTurned && rJoint.m_Rest.R != Rotation::c_Identity3);
		std::vector<EChannel> channels = rJoint.m_Channels;
		if (m_bAddsTurn.back())
			channels.insert(channels.end(), std::begin(c_Added), std::end(c_Added));
		Line(i_Depth + 1, "CHANNELS ");
		m_Text += std::to_string(channels.size());
		for (const EChannel channel : channels)
			m_Text.append(" ").append(
			    c_ChannelNames[AxisToFile(m_rTake.m_FileUp, AxisOf(channel)).m_Axis + (IsRotation(channel) ? 3 : 0)]);
		m_Text += '\n';
		for (const Rotation::VVector3& rEnd : rJoint.m_Ends)
		{
			Line(i_Depth + 1, "End Site\n");
			Line(i_Depth + 1, "{\n");
			WriteOffset(i_Depth + 2, rEnd);
			Line(i_Depth + 1, "}\n");
		}
	}

	void WriteOffset(std::size_t i_Depth, const Rotation::VVector3& i_rPoint)
	{
		Line(i_Depth, "OFFSET");
		for (const double number : MapVector(AxisToFile, m_rTake.m_FileUp, 1.0 / m_rTake.m_FileUnit, i_rPoint))
			WriteNumber(number);
		m_Text += '\n';
	}

	void WriteNumber(double i_Number)
	{
		m_Text += ' ';
		NumberText::AppendG(m_Text, i_Number, c_Digits);
	}

	void WriteValue(EChannel i_Channel, double i_Value)
	{
		const double factor = IsRotation(i_Channel) ? 180.0 / std::numbers::pi : 1.0 / m_rTake.m_FileUnit;
		WriteNumber(i_Value * factor * AxisToFile(m_rTake.m_FileUp, AxisOf(i_Channel)).m_Sign);
	}

	void WriteFrame(std::size_t i_Frame)
	{
		const std::size_t begin = m_Text.size();
		const double* const pValues = m_rTake.Frame(i_Frame);
		for (std::size_t i = 0; i < m_Order.size(); ++i)
		{
			const VJoint& rJoint = m_rTake.m_Joints[m_Order[i]];
			for (std::size_t k = 0; k < rJoint.m_Channels.size(); ++k)
				WriteValue(rJoint.m_Channels[k], pValues[rJoint.m_FirstValue + k]);
			if (!m_bAddsTurn[i])
				continue;
			Rotation::VVector3 angles{};
			Rotation::EulerFromRotationMatrix(rJoint.m_Rest.R, Rotation::EZYX, angles);
			for (std::size_t k = 0; k < 3; ++k)
				WriteValue(c_Added[k], angles[k]);
		}
		m_Text += '\n';
		// No blank before the first.
		if (m_Text[begin] == ' ')
			m_Text.erase(begin, 1);
	}

	static constexpr EChannel c_Added[]{EChannel::ZRotation, EChannel::YRotation, EChannel::XRotation};

	const VTake& m_rTake;
	std::vector<std::vector<std::size_t>> m_Children;
	/// As they stand in the file: the order of their values.
	std::vector<std::size_t> m_Order;
	std::vector<bool> m_bAddsTurn;
	std::string m_Text;
};

} // namespace

std::string TakeIO::PrintBvh(const VTake& i_rTake)
{
	return VBvhWriter(i_rTake).Write();
}
