#pragma once

#include <QOpenGLFunctions>

#include <functional>
#include <vector>

/// Counts what asks OpenGL for its state, or for a place by its name, as long as it lives: each glGet... that is called
/// through Qt in the current context. It waits for the driver, and has no place in the drawing of a frame.
class VQueryCount : private QOpenGLFunctions
{
public:
	VQueryCount();
	~VQueryCount();

	static std::size_t Count() { return s_Count; }

private:
	/// Puts a function that counts in place of one of OpenGL's.
	template <int Slot, typename TReturn, typename... TArguments>
	void Replace(TReturn (*&io_rpFunction)(TArguments...))
	{
		static TReturn (*s_pFunction)(TArguments...);
		s_pFunction = io_rpFunction;
		io_rpFunction = [](TArguments... i_Arguments)
		{
			++s_Count;
			return s_pFunction(i_Arguments...);
		};
		m_Restore.push_back([&io_rpFunction] { io_rpFunction = s_pFunction; });
	}

	static inline std::size_t s_Count = 0;
	std::vector<std::function<void()>> m_Restore;
};
