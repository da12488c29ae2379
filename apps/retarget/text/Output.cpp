#include "retarget/text/Output.h"

#include "CommandLineText/ExitStatus.h"
#include "CommandLineText/Messages.h"
#include "math/VisibleText.h"

#include <cerrno>
#include <cstdio>
#include <cstring>

namespace CommandLine
{
namespace
{

bool IsFlat(const VJson& i_rValue)
{
	for (const VJson& rItem : i_rValue)
		if (rItem.is_structured() && !rItem.empty())
			return false;
	return true;
}

std::string Scalar(const VJson& i_rValue)
{
	return i_rValue.dump(-1, ' ', false, VJson::error_handler_t::replace);
}

/// Values that hold only scalars stay on one line, so that matrices and lists can be read.
void Append(std::string& io_rText, const VJson& i_rValue, std::size_t i_Indent)
{
	if (!i_rValue.is_structured() || i_rValue.empty())
	{
		io_rText += Scalar(i_rValue);
		return;
	}
	const bool bObject = i_rValue.is_object();
	const bool bLines = bObject || !IsFlat(i_rValue);
	io_rText += bObject ? '{' : '[';
	bool bFirst = true;
	for (auto it = i_rValue.begin(); it != i_rValue.end(); ++it)
	{
		if (!bFirst)
			io_rText += bLines ? "," : ", ";
		bFirst = false;
		if (bLines)
		{
			io_rText += '\n';
			io_rText.append(i_Indent + 1, ' ');
		}
		if (bObject)
		{
			io_rText += Scalar(it.key());
			io_rText += ": ";
		}
		Append(io_rText, *it, i_Indent + 1);
	}
	if (bLines)
	{
		io_rText += '\n';
		io_rText.append(i_Indent, ' ');
	}
	io_rText += bObject ? '}' : ']';
}

} // namespace

void Print(std::string_view i_Text)
{
	ReleaseMessages();
	errno = 0;
	if (std::fwrite(i_Text.data(), 1, i_Text.size(), stdout) != i_Text.size() || std::fflush(stdout) != 0)
		throw VCommandError(EBadOutput, std::string("Error writing to standard output: ") + std::strerror(errno));
}

std::string JsonText(const VJson& i_rValue)
{
	std::string text;
	Append(text, i_rValue, 0);
	return VisibleText::InJson(text);
}

void PrintResult(const VJson& i_rJson, std::string_view i_Text)
{
	if (JsonAsked())
		PrintJson(i_rJson);
	else if (!i_Text.empty())
		Print(i_Text);
}

void PrintJson(const VJson& i_rValue)
{
	Print(JsonText(i_rValue) + "\n");
}

std::string Printable(std::string_view i_Text)
{
	return VisibleText::OnOneLine(i_Text);
}

} // namespace CommandLine
