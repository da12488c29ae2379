#pragma once

#include <cstddef>
#include <mutex>
#include <vector>

namespace FbxFormat
{

/// A tool that is dear to make, for as long as this lives; then the next one who asks has it, on any thread. Kept by no
/// thread: g++'s runtime on Windows frees what belongs to a thread before it destroys it.
/// @tparam t_Make gives a pointer, which may be null. @tparam t_Free takes it.
template <auto t_Make, auto t_Free>
class VLent
{
	using VTool = decltype(t_Make());

	struct VIdle
	{
		~VIdle()
		{
			for (const VTool pTool : m_Tools)
				t_Free(pTool);
		}
		std::mutex m_Mutex;
		std::vector<VTool> m_Tools;
		std::size_t m_Made = 0;
	};
	static VIdle& Idle()
	{
		static VIdle s_Idle;
		return s_Idle;
	}
	static VTool Take()
	{
		VIdle& rIdle = Idle();
		const std::lock_guard lock(rIdle.m_Mutex);
		if (rIdle.m_Tools.empty())
		{
			// So that nothing has to be allocated when it comes back.
			rIdle.m_Tools.reserve(++rIdle.m_Made);
			return t_Make();
		}
		const VTool pTool = rIdle.m_Tools.back();
		rIdle.m_Tools.pop_back();
		return pTool;
	}

public:
	VLent() : m_pTool(Take()) {}
	VLent(const VLent&) = delete;
	VLent& operator=(const VLent&) = delete;
	~VLent()
	{
		VIdle& rIdle = Idle();
		const std::lock_guard lock(rIdle.m_Mutex);
		if (m_pTool)
			rIdle.m_Tools.push_back(m_pTool);
	}
	VTool Get() const { return m_pTool; }

private:
	const VTool m_pTool;
};

} // namespace FbxFormat
