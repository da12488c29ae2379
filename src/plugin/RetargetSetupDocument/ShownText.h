#pragma once

#include "math/VisibleText.h"

#include <QString>

namespace RetargetSetup
{

/// A name or a sentence with names in it as it is shown: nothing in it is invisible or turns its direction.
inline QString ShownText(const std::string& i_rText)
{
	return QString::fromStdString(VisibleText::Of(i_rText));
}

} // namespace RetargetSetup
