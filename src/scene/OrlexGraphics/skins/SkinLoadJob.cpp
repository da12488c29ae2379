#include "OrlexGraphics/skins/SkinLoadJob.h"

#include "CoreGraphics/Picture.h"
#include "CoreGraphics/Skin.h"
#include "DebugServices/GlobalLog.h"
#include "FBXIO/FBXReader.h"
#include "UtilsFileSystem/Paths.h"

namespace OrlexGraphics
{

namespace
{

/// What of a skin that could be read is not to be seen.
void WarnOfParts(const CoreGraphics::VSkin& i_rSkin, bool i_bComplete, const std::string& i_rPath)
{
	if (!i_bComplete)
		NVX_LOG("VSkinCache", NVX::ELogWarning, "The skin %1% is shown in part: %2% could not be read to its end",
		    i_rSkin.Name(), i_rPath);
	if (const std::size_t bones = i_rSkin.Skeleton()->size(); bones > CoreGraphics::c_MaxSkinBones)
		NVX_LOG("VSkinCache", NVX::ELogWarning,
		    "The skin %1% has %2% bones: %3% are shown, what the others move goes with a bone that is not its own",
		    i_rSkin.Name(), bones, CoreGraphics::c_MaxSkinBones);
}

} // namespace

VSkinLoadJob::VSkinLoadJob(boost::filesystem::path i_Path, std::string i_Name, const FBXIO::VMeshRules& i_rRules)
    : m_Path(std::move(i_Path)), m_Name(std::move(i_Name)), m_Rules(i_rRules)
{
}

void VSkinLoadJob::Run()
{
	const std::string path = UtilsFileSystem::ToUtf8(m_Path);
	std::shared_ptr<CoreGraphics::VSkin> pSkin;
	try
	{
		FBXIO::FBXReader reader;
		FBXIO::VSkin data;
		reader.SetMeshRules(m_Rules);
		reader.SetPictures(&CoreGraphics::OpenPicture);
		if (!reader.LoadFile(path))
			NVX_LOG("VSkinCache", NVX::ELogError, "The skin %1% is not shown: %2% could not be read", m_Name, path);
		else
		{
			reader.ReadSkin(data);
			pSkin = std::make_shared<CoreGraphics::VSkin>(data, m_Name);
			if (data.m_Meshes.empty())
				NVX_LOG("VSkinCache", NVX::ELogWarning, "The skin %1% is not shown: no mesh in %2% is bound to bones",
				    m_Name, path);
			else
				WarnOfParts(*pSkin, reader.IsComplete(), path);
		}
	}
	catch (const std::exception& rError)
	{
		pSkin.reset();
		NVX_LOG("VSkinCache", NVX::ELogError, "The skin %1% is not shown: %2% could not be read: %3%", m_Name, path,
		    rError.what());
	}
	const std::lock_guard lock(m_Mutex);
	m_pSkin = std::move(pSkin);
	m_Status = m_pSkin ? SkinStatus::c_Ready : SkinStatus::c_LoadFailed;
}

std::uint32_t VSkinLoadJob::Result(std::shared_ptr<CoreGraphics::VSkin>& o_rpSkin)
{
	const std::lock_guard lock(m_Mutex);
	if (m_pSkin)
		o_rpSkin = m_pSkin;
	return m_Status;
}

} // namespace OrlexGraphics
