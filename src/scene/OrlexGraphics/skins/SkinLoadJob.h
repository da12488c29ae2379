#pragma once

#include "OrlexGraphics/skins/SkinCache.h"

namespace OrlexGraphics
{

/// The loading of one file, which touches no OpenGL.
class VSkinLoadJob
{
public:
	/// @param i_Name as messages call the skin
	VSkinLoadJob(boost::filesystem::path i_Path, std::string i_Name, const FBXIO::VMeshRules& i_rRules);

	const std::string& Name() const { return m_Name; }

	/// The whole of it. Once, on any thread; what goes wrong is told in the log.
	void Run();

	/// Any thread.
	/// @param o_rpSkin set if the status is ready
	/// @return SkinStatus: not looked for until Run is done, then ready or failed.
	std::uint32_t Result(std::shared_ptr<CoreGraphics::VSkin>& o_rpSkin);

private:
	const boost::filesystem::path m_Path;
	const std::string m_Name;
	const FBXIO::VMeshRules m_Rules;
	/// Guards what follows.
	std::mutex m_Mutex;
	std::uint32_t m_Status = SkinStatus::c_NotLookedFor;
	std::shared_ptr<CoreGraphics::VSkin> m_pSkin;
};

} // namespace OrlexGraphics
