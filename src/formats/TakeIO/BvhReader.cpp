#include "TakeIO/BvhReader.h"

#include "DebugServices/GlobalLog.h"
#include "TakeIO/Axes.h"
#include "TakeIO/Guess.h"
#include "TakeIO/Limits.h"
#include "math/NumberText.h"

#include <algorithm>
#include <charconv>
#include <cmath>
#include <numbers>

namespace
{

using namespace TakeIO;

constexpr bool IsBlank(char i_Byte)
{
	return i_Byte == ' ' || i_Byte == '\t' || i_Byte == '\f' || i_Byte == '\v';
}

constexpr bool IsLineEnd(char i_Byte)
{
	return i_Byte == '\n' || i_Byte == '\r';
}

constexpr bool IsSpace(char i_Byte)
{
	return IsBlank(i_Byte) || IsLineEnd(i_Byte);
}

/// Keywords in any case.
bool IsWord(std::string_view i_Text, std::string_view i_Word)
{
	const auto lower = [](char i_Byte) { return i_Byte >= 'A' && i_Byte <= 'Z' ? char(i_Byte - 'A' + 'a') : i_Byte; };
	return std::ranges::equal(i_Text, i_Word, {}, lower, lower);
}

constexpr std::string_view c_Mark = "\xEF\xBB\xBF";

/// Goes through the text, and knows the line.
class VText
{
public:
	explicit VText(std::string_view i_Text) : m_p(i_Text.data()), m_pEnd(m_p + i_Text.size()) {}

	bool IsAtEnd() const { return m_p == m_pEnd; }
	std::size_t Line() const { return m_Line; }
	std::size_t BytesLeft() const { return std::size_t(m_pEnd - m_p); }

	void SkipBlanks()
	{
		while (m_p != m_pEnd && IsBlank(*m_p))
			++m_p;
	}

	void SkipSpace()
	{
		for (SkipBlanks(); m_p != m_pEnd && IsLineEnd(*m_p); SkipBlanks())
			SkipLineEnd();
	}

	/// True, with the line left behind, if nothing more stands in it.
	bool EndsLine()
	{
		SkipBlanks();
		if (m_p == m_pEnd)
			return true;
		if (!IsLineEnd(*m_p))
			return false;
		SkipLineEnd();
		return true;
	}

	/// Empty at the end. Braces are words of their own.
	std::string_view Word()
	{
		SkipSpace();
		const char* const pWord = m_p;
		if (m_p != m_pEnd && (*m_p == '{' || *m_p == '}'))
			++m_p;
		else
			while (m_p != m_pEnd && !IsSpace(*m_p) && *m_p != '{' && *m_p != '}')
				++m_p;
		return {pWord, std::size_t(m_p - pWord)};
	}

	/// What the line still holds, up to a brace that ends it, without blanks around it.
	std::string_view Name()
	{
		SkipBlanks();
		const char* const pName = m_p;
		while (m_p != m_pEnd && !IsLineEnd(*m_p))
			++m_p;
		const char* pNameEnd = m_p;
		const auto trim = [&]
		{
			while (pNameEnd != pName && IsBlank(pNameEnd[-1]))
				--pNameEnd;
		};
		trim();
		while (pNameEnd != pName && pNameEnd[-1] == '{')
		{
			m_p = --pNameEnd;
			trim();
		}
		return {pName, std::size_t(pNameEnd - pName)};
	}

	/// A number of at most c_Largest, or false, where the text stands still.
	bool Number(double& o_rNumber)
	{
		const auto [p, error] = std::from_chars(m_p, m_pEnd, o_rNumber);
		if (error == std::errc() && (p == m_pEnd || IsSpace(*p)) && std::abs(o_rNumber) <= Limits::c_Largest)
		{
			m_p = p;
			return true;
		}
		// A sign in front, numbers too small for their type.
		const char* pWordEnd = m_p;
		while (pWordEnd != m_pEnd && !IsSpace(*pWordEnd))
			++pWordEnd;
		if (pWordEnd == m_p || !NumberText::ScanWholeReal({m_p, std::size_t(pWordEnd - m_p)}, o_rNumber)
		    || !(std::abs(o_rNumber) <= Limits::c_Largest))
			return false;
		m_p = pWordEnd;
		return true;
	}

private:
	void SkipLineEnd()
	{
		const bool bTwo = m_pEnd - m_p > 1 && m_p[0] == '\r' && m_p[1] == '\n';
		m_p += bTwo ? 2 : 1;
		++m_Line;
	}

	const char* m_p;
	const char* m_pEnd;
	std::size_t m_Line = 1;
};

class VBvhReader
{
public:
	VBvhReader(std::string_view i_Bytes, const VTakeSettings& i_rSettings, VTake& o_rTake)
	    : m_rSettings(i_rSettings), m_Bytes(i_Bytes.size()), m_Text(i_Bytes), m_rTake(o_rTake)
	{
	}

	bool Read()
	{
		m_rTake = {};
		m_Text.Word();
		return ReadHierarchy() && Place() && ReadHead() && ReadFrames();
	}

	std::string m_Error;

private:
	bool Fail(const std::string& i_rWhat, std::size_t i_Line)
	{
		m_Error = "Line " + std::to_string(i_Line) + ": " + i_rWhat;
		return false;
	}
	bool Fail(const std::string& i_rWhat) { return Fail(i_rWhat, m_Text.Line()); }

	/// For messages: what stands there, not all of it.
	static std::string Quoted(std::string_view i_Text)
	{
		return '"' + std::string(i_Text.substr(0, 40)) + (i_Text.size() > 40 ? "...\"" : "\"");
	}

	bool ReadHierarchy()
	{
		while (true)
		{
			const std::string_view word = m_Text.Word();
			if (word.empty())
				return Fail("It ends before its MOTION");
			if (IsWord(word, "MOTION"))
				break;
			if (!ReadItem(word))
				return false;
		}
		if (!m_Open.empty())
			return Fail("MOTION stands inside the braces of " + Quoted(Open().m_Name));
		return !m_rTake.m_Joints.empty() || Fail("It has no joints");
	}

	VJoint& Open() { return m_rTake.m_Joints[std::size_t(m_Open.back())]; }

	bool ReadItem(std::string_view i_Word)
	{
		if (i_Word == "}")
		{
			if (m_Open.empty())
				return Fail("A brace closes nothing");
			if (!m_bInEnd)
				m_Open.pop_back();
			m_bInEnd = false;
			return true;
		}
		const bool bInJoint = !m_Open.empty() && !m_bInEnd;
		if (bInJoint && IsWord(i_Word, "JOINT"))
			return ReadJoint(m_Open.back());
		if (m_Open.empty() && IsWord(i_Word, "ROOT"))
			return ReadJoint(-1);
		if (bInJoint && IsWord(i_Word, "End"))
		{
			m_Text.Name();
			m_bInEnd = true;
			return ReadBrace();
		}
		if (!m_Open.empty() && IsWord(i_Word, "OFFSET"))
			return ReadOffset();
		if (bInJoint && IsWord(i_Word, "CHANNELS"))
			return ReadChannels();
		return Fail(Quoted(i_Word) + " does not belong here");
	}

	bool ReadBrace() { return m_Text.Word() == "{" || Fail("A brace is missing"); }

	bool ReadJoint(std::int32_t i_Parent)
	{
		if (m_rTake.m_Joints.size() == Limits::c_Joints)
			return Fail("It has more than " + std::to_string(Limits::c_Joints) + " joints");
		VJoint& rJoint = m_rTake.m_Joints.emplace_back();
		const std::string_view name = m_Text.Name();
		if (name.empty())
			return Fail("A joint without a name");
		if (name.size() > Limits::c_NameBytes)
			return Fail("A name has more than " + std::to_string(Limits::c_NameBytes) + " bytes");
		rJoint.m_Name = name;
		rJoint.m_Parent = i_Parent;
		rJoint.m_FirstValue = m_rTake.m_Channels;
		m_Open.push_back(std::int32_t(m_rTake.m_Joints.size()) - 1);
		return ReadBrace();
	}

	bool ReadOffset()
	{
		Rotation::VVector3 offset;
		for (double& rCoordinate : offset)
		{
			m_Text.SkipSpace();
			if (!m_Text.Number(rCoordinate))
				return Fail("OFFSET needs three numbers, not " + Quoted(m_Text.Word()));
		}
		if (m_bInEnd)
			Open().m_Ends.push_back(offset);
		else
			Open().m_Rest.t = offset;
		return true;
	}

	bool ReadChannels()
	{
		double count = 0.0;
		m_Text.SkipSpace();
		if (!Open().m_Channels.empty())
			return Fail("A second CHANNELS of " + Quoted(Open().m_Name));
		if (Open().m_FirstValue != m_rTake.m_Channels)
			return Fail("CHANNELS must stand before the joints below " + Quoted(Open().m_Name));
		if (!m_Text.Number(count) || !(count >= 0.0 && count <= double(Limits::c_Channels))
		    || count != std::floor(count))
			return Fail("CHANNELS needs a count up to " + std::to_string(Limits::c_Channels));
		for (int i = 0; i < int(count); ++i)
		{
			const std::string_view name = m_Text.Word();
			const auto* const pFound =
			    std::ranges::find_if(c_ChannelNames, [name](std::string_view i_Name) { return IsWord(name, i_Name); });
			if (pFound == std::end(c_ChannelNames))
				return Fail(Quoted(name) + " is no channel: of X, Y and Z there are position and rotation");
			Open().m_Channels.push_back(EChannel(pFound - c_ChannelNames));
		}
		m_rTake.m_Channels += Open().m_Channels.size();
		return true;
	}

	/// Turns joints and channels from the file's axes and unit into ours.
	bool Place()
	{
		const EUp up = m_rSettings.m_Up.value_or(GuessUp(m_rTake));
		if (!m_rSettings.m_Up && up == EUp::Z)
			NVX_LOG(
			    "TakeIO", NVX::ELogWarning, "Taken as having Z up, as its rest pose reaches further along Z than Y");
		const double height = HipsHeight(m_rTake, up);
		const VUnit guessed = GuessUnit(height);
		const double unit = m_rSettings.m_Unit.value_or(guessed.m_Size);
		if (!m_rSettings.m_Unit)
			NVX_LOG("TakeIO", guessed.m_bFits ? NVX::ELogInformation : NVX::ELogWarning,
			    guessed.m_bFits ? "Taken as being in %1% (%2% mm): its hips stand %3% of them high"
			                    : "Taken as being in %1% (%2% mm), though its hips stand %3% of them high, which no "
			                      "unit makes those of a person. Give the unit if it is another one",
			    guessed.m_pName, ShortText(guessed.m_Size), ShortText(height));
		m_rTake.m_FileUp = up;
		m_rTake.m_FileUnit = unit;
		m_Factors.reserve(m_rTake.m_Channels);
		for (VJoint& rJoint : m_rTake.m_Joints)
		{
			rJoint.m_Rest.t = MapVector(AxisFromFile, up, unit, rJoint.m_Rest.t);
			for (Rotation::VVector3& rEnd : rJoint.m_Ends)
				rEnd = MapVector(AxisFromFile, up, unit, rEnd);
			for (EChannel& rChannel : rJoint.m_Channels)
			{
				const VAxis axis = AxisFromFile(up, AxisOf(rChannel));
				const bool bRotation = IsRotation(rChannel);
				m_Factors.push_back(axis.m_Sign * (bRotation ? std::numbers::pi / 180.0 : unit));
				rChannel = EChannel(axis.m_Axis + (bRotation ? 3 : 0));
			}
		}
		return true;
	}

	static std::string ShortText(double i_Number, int i_Digits = 5)
	{
		std::string text;
		NumberText::AppendG(text, i_Number, i_Digits);
		return text;
	}

	/// "Frames: 2", "Frame Time: 0.1", with the colon where it pleases.
	bool ReadLabelled(std::initializer_list<std::string_view> i_Words, double& o_rNumber)
	{
		for (const std::string_view word : i_Words)
		{
			std::string_view found = m_Text.Word();
			found.remove_suffix(found.ends_with(':') ? 1 : 0);
			if (!IsWord(found, word))
				return Fail(Quoted(found) + " stands where \"Frames:\" and \"Frame Time:\" are expected");
		}
		m_Text.SkipSpace();
		double number = 0.0;
		if (!m_Text.Number(number))
		{
			if (m_Text.Word() != ":")
				return Fail("A number is missing behind \"" + std::string(*(i_Words.end() - 1)) + "\"");
			m_Text.SkipSpace();
			if (!m_Text.Number(number))
				return Fail("A number is missing behind \"" + std::string(*(i_Words.end() - 1)) + "\"");
		}
		o_rNumber = number;
		return true;
	}

	bool ReadHead()
	{
		double time = 0.0;
		if (!ReadLabelled({"Frames"}, m_Claimed) || !ReadLabelled({"Frame", "Time"}, time))
			return false;
		const double rate = 1.0 / time;
		if (rate >= Limits::c_LeastRate && rate <= Limits::c_GreatestRate)
			m_rTake.m_Rate = NearestRate(rate);
		else
		{
			m_rTake.m_Rate = m_rSettings.m_Rate.value_or(c_UnknownRate);
			NVX_LOG("TakeIO", NVX::ELogWarning,
			    "Its time between frames is none (%1% s): played at %2% frames a second", ShortText(time),
			    ShortText(m_rTake.m_Rate));
		}
		return m_Text.EndsLine() || Fail(Quoted(m_Text.Word()) + " stands behind the frame time");
	}

	/// The time between frames is printed with few digits: .0083333 is 120 Hz, 0.033367 the 30000/1001 of television.
	static double NearestRate(double i_Rate)
	{
		double nearest = i_Rate;
		double least = 1e-4 * i_Rate;
		for (const double unit : {1.0, 1000.0 / 1001.0})
		{
			const double rate = std::round(i_Rate / unit) * unit;
			if (rate > 0.0 && std::abs(rate - i_Rate) < least)
			{
				nearest = rate;
				least = std::abs(rate - i_Rate);
			}
		}
		return nearest;
	}

	bool ReadFrames()
	{
		const std::size_t channels = m_rTake.m_Channels;
		std::vector<double>& rValues = m_rTake.m_Values;
		// Each value takes two bytes at least.
		const double backed = double(m_Text.BytesLeft()) / 2.0 + 1.0;
		rValues.reserve(
		    std::size_t(std::clamp(m_Claimed * double(channels), 0.0, std::min(backed, double(Limits::c_Values)))));
		std::size_t shortLine = 0;
		while (true)
		{
			m_Text.SkipSpace();
			if (m_Text.IsAtEnd())
				break;
			const std::size_t line = m_Text.Line();
			if (shortLine > 0)
				return Fail("It has fewer values than the " + std::to_string(channels) + " channels", shortLine);
			if (rValues.size() + channels > Limits::c_Values)
				return Fail("It has more than " + std::to_string(Limits::c_Values) + " values");
			std::size_t count = 0;
			for (; !m_Text.EndsLine(); ++count)
			{
				if (count == channels)
					return Fail("It has more values than the " + std::to_string(channels) + " channels");
				double number = 0.0;
				if (!m_Text.Number(number))
					return Fail(Quoted(m_Text.Word()) + " is no number, or beyond any stage");
				rValues.push_back(number * m_Factors[count]);
			}
			if (count < channels)
			{
				rValues.resize(rValues.size() - count);
				shortLine = line;
			}
			else
				++m_rTake.m_Frames;
			if (m_rTake.m_Frames % c_FramesBetweenProgress == 0 && m_rSettings.m_Progress
			    && !m_rSettings.m_Progress(1.0 - double(m_Text.BytesLeft()) / double(m_Bytes)))
				return Fail("The reading was ended");
		}
		if (shortLine > 0)
			NVX_LOG("TakeIO", NVX::ELogWarning, "Its last line (%1%) is cut off and left out", shortLine);
		if (m_Claimed != double(m_rTake.m_Frames))
			NVX_LOG("TakeIO", NVX::ELogWarning, "It says that it has %1% frames, and has %2%, which are read",
			    ShortText(m_Claimed, 10), m_rTake.m_Frames);
		return true;
	}

	static constexpr std::size_t c_FramesBetweenProgress = 256;
	/// What television had; takes without a time between frames are still poses.
	static constexpr double c_UnknownRate = 30.0;

	const VTakeSettings& m_rSettings;
	const std::size_t m_Bytes;
	VText m_Text;
	VTake& m_rTake;
	std::vector<std::int32_t> m_Open;
	bool m_bInEnd = false;
	double m_Claimed = 0.0;
	/// From the file's unit and degrees into ours, by channel.
	std::vector<double> m_Factors;
};

std::string_view WithoutMark(std::string_view i_Bytes)
{
	return i_Bytes.substr(i_Bytes.starts_with(c_Mark) ? c_Mark.size() : 0);
}

} // namespace

bool TakeIO::IsBvh(std::string_view i_Bytes)
{
	return IsWord(VText(WithoutMark(i_Bytes)).Word(), "HIERARCHY");
}

bool TakeIO::ReadBvh(std::string_view i_Bytes, const VTakeSettings& i_rSettings, VTake& o_rTake, std::string& o_rError)
{
	VBvhReader reader(WithoutMark(i_Bytes), i_rSettings, o_rTake);
	const bool bRead = reader.Read();
	o_rError = std::move(reader.m_Error);
	return bRead;
}
