#include "retarget/python/Call.h"

#include "CommandLineText/ExitStatus.h"
#include "retarget/python/Records.h"

#include "DebugServices/GlobalLog.h"

#include <pybind11/pybind11.h>

#include <exception>
#include <memory>
#include <mutex>
#include <string>
#include <utility>
#include <vector>

namespace CommandLine::Python
{
namespace
{

namespace py = pybind11;

struct VMessage
{
	const NVX::VLogCategory* m_pCategory;
	int m_Level;
	std::string m_Text;
};
using VMessages = std::vector<VMessage>;

/// So many messages of one call are kept: a hostile file must not fill the memory.
constexpr std::size_t c_MaximumMessages = 10000;

struct VInbox
{
	std::mutex m_Mutex;
	/// Of threads that are in no call.
	VMessages m_Others;
	std::shared_ptr<void> m_pToken;
	const void* m_pErrorType = nullptr;
};

/// Never destroyed: threads may log until the process ends.
VInbox& Inbox()
{
	static auto* const s_pInbox = new VInbox;
	return *s_pInbox;
}

/// Of the call that this thread is in.
thread_local VMessages* t_pMessages = nullptr;

void Receive(const NVX::VLogCategory& i_rCategory, int i_Level, const std::string& i_rText)
{
	const auto keep = [&](VMessages& io_rMessages)
	{
		if (io_rMessages.size() < c_MaximumMessages)
			io_rMessages.push_back({&i_rCategory, i_Level, i_rText});
	};
	if (t_pMessages)
		return keep(*t_pMessages);
	const std::lock_guard lock(Inbox().m_Mutex);
	keep(Inbox().m_Others);
}

py::object Logger(const std::string& i_rCategory)
{
	return py::module_::import("logging").attr("getLogger")("retarget_setup" + i_rCategory);
}

/// As much as the package's logger wants, but at least warnings: errors are the text of exceptions.
void SetLevel()
{
	const int wanted = Logger("").attr("getEffectiveLevel")().cast<int>();
	NVX::GlobalLog::SetDefaultLevel(wanted <= 10 ? NVX::ELogDetail
	        : wanted <= 20                       ? NVX::ELogInformation
	                                             : NVX::ELogWarning);
}

int PythonLevel(int i_Level)
{
	switch (i_Level)
	{
	case NVX::ELogError: return 40;
	case NVX::ELogWarning: return 30;
	case NVX::ELogInformation: return 20;
	default: return 10;
	}
}

void Tell(const VMessages& i_rMessages)
{
	for (const VMessage& rMessage : i_rMessages)
		Logger("." + rMessage.m_pCategory->Name())
		    .attr("log")(PythonLevel(rMessage.m_Level), "%s", TextToPython(rMessage.m_Text));
}

[[noreturn]] void Raise(const std::string& i_rText, int i_Status)
{
	const py::handle type(static_cast<PyObject*>(const_cast<void*>(Inbox().m_pErrorType)));
	PyErr_SetObject(type.ptr(), type(TextToPython(i_rText), i_Status).ptr());
	throw py::error_already_set();
}

} // namespace

void Call(const std::function<void()>& i_rWork, bool i_bForgive)
{
	SetLevel();
	VMessages messages;
	VMessages others;
	std::exception_ptr pFailure;
	{
		const py::gil_scoped_release release;
		VMessages* const pOuter = std::exchange(t_pMessages, &messages);
		try
		{
			i_rWork();
		}
		catch (...)
		{
			pFailure = std::current_exception();
		}
		t_pMessages = pOuter;
		const std::lock_guard lock(Inbox().m_Mutex);
		others.swap(Inbox().m_Others);
	}
	Tell(others);
	Tell(messages);
	std::string errors;
	for (const VMessage& rMessage : messages)
		if (rMessage.m_Level <= NVX::ELogError)
			errors += (errors.empty() ? "" : "\n") + rMessage.m_Text;
	try
	{
		if (pFailure)
			std::rethrow_exception(pFailure);
	}
	catch (const VCommandError& rError)
	{
		Raise(rError.what() + (errors.empty() ? "" : "\n" + errors), rError.Status());
	}
	if (!errors.empty() && !i_bForgive)
		Raise(errors, EBadInput);
}

void RegisterError(const void* i_pType)
{
	Inbox().m_pErrorType = i_pType;
}

void BeginListening()
{
	Inbox().m_pToken = NVX::GlobalLog::AddSink(Receive);
}

void EndListening()
{
	Inbox().m_pToken.reset();
}

} // namespace CommandLine::Python
