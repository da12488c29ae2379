#pragma once

#include <QImage>

#include <functional>
#include <map>
#include <memory>
#include <string>

namespace FBXIO
{

/// Images by the exact path that they were asked for with. Belongs to one thread at a time.
class ImageCache
{
public:
	/// Reads the file the first time. Empty if it is no image: told once in the category "Import".
	std::shared_ptr<const QImage> Get(const std::string& i_rPath);

	/// The same of a picture that i_rRead gives the file of, under a name that is no path of a file.
	std::shared_ptr<const QImage> Get(const std::string& i_rName, const std::function<std::string()>& i_rRead);

private:
	std::map<std::string, std::shared_ptr<const QImage>> m_Images;
};

} // namespace FBXIO
