#include "Rows.h"

#include <nlohmann/json.hpp>

namespace
{

using VJson = nlohmann::json;

const std::string c_Performer = Data("qrt/performer.qrs");

/// A small subject, sound as it stands: two segments, two markers, and a target.
const std::string c_Sound = R"(<?xml version="1.0"?>
<KinematicModel MODEL="" VERSION="3.5">
	<Parameters>
		<Parameter NAME="GlobalScale" VALUE="1" PRIOR="1" SD="0" HIDDEN="true"/>
	</Parameters>
	<Skeleton>
		<Segment NAME="Hips" BOUNDS="0 0 0 0 0 0">
			<JointFree NAME="Root" PRE-POSITION="0 0 0" PRE-ORIENTATION="0 0 0"/>
		</Segment>
	</Skeleton>
</KinematicModel>
)";

/// The text with a part of it replaced, which must be there.
std::string Replaced(std::string i_Text, const std::string& i_rFrom, const std::string& i_rTo)
{
	const std::size_t at = i_Text.find(i_rFrom);
	EXPECT_NE(at, std::string::npos) << i_rFrom;
	return at == std::string::npos ? i_Text : i_Text.replace(at, i_rFrom.size(), i_rTo);
}

} // namespace
