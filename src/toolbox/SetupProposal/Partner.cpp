#include "SetupProposal/Partner.h"

#include "SetupProposal/BodyFrame.h"
#include "SetupProposal/Twins.h"

#include <cmath>

namespace SetupProposal
{
namespace
{

/// Parts of the height: a joint this near to the mirror plane has no partner, and one that is farther than this from
/// the mirror image is none.
constexpr double c_InTheMiddle = 0.01;
constexpr double c_FromTheImage = 0.03;

double FromMirrorImage(const VBodyPlace& i_rA, const VBodyPlace& i_rB)
{
	return std::hypot(i_rA.m_Left + i_rB.m_Left, i_rA.m_Forward - i_rB.m_Forward, i_rA.m_Up - i_rB.m_Up);
}

std::int64_t ByNames(const std::vector<VNameWords>& i_rNames, std::size_t i_Joint)
{
	const VNameWords& rName = i_rNames[i_Joint];
	for (std::size_t i = 0; i < i_rNames.size() && rName.m_Side != ESide::None; ++i)
		if (i_rNames[i].m_Side == Opposite(rName.m_Side) && i_rNames[i].m_Words == rName.m_Words
		    && i_rNames[i].m_Digits == rName.m_Digits)
			return std::int64_t(i);
	return -1;
}

std::int64_t ByPlaces(const VRestSkeleton& i_rSkeleton, const std::vector<VNameWords>& i_rNames, std::size_t i_Joint)
{
	const VBodyFrame frame = BodyFrameOf(i_rSkeleton, i_rNames, FindTwins(i_rSkeleton));
	const VBodyPlace place = PlaceIn(frame, i_rSkeleton[i_Joint].m_Place);
	if (std::abs(place.m_Left) < c_InTheMiddle)
		return -1;
	std::int64_t nearest = -1;
	double least = c_FromTheImage;
	for (std::size_t i = 0; i < i_rSkeleton.size(); ++i)
	{
		const VBodyPlace other = PlaceIn(frame, i_rSkeleton[i].m_Place);
		const bool bSameSide = i_rNames[i].m_Side != ESide::None && i_rNames[i].m_Side == i_rNames[i_Joint].m_Side;
		const double away = FromMirrorImage(place, other);
		// One that has a partner by its name is no one else's.
		if (i != i_Joint && !bSameSide && other.m_Left * place.m_Left < 0.0 && away < least && ByNames(i_rNames, i) < 0)
		{
			least = away;
			nearest = std::int64_t(i);
		}
	}
	return nearest;
}

} // namespace

VPartner FindPartner(const VRestSkeleton& i_rSkeleton, std::size_t i_Joint)
{
	if (i_Joint >= i_rSkeleton.size())
		return {};
	const VRestSkeleton skeleton = Sound(i_rSkeleton);
	std::vector<std::string_view> texts;
	for (const VRestJoint& rJoint : skeleton)
		texts.push_back(rJoint.m_Name);
	const std::vector<VNameWords> names = WordsOf(texts);
	if (const std::int64_t joint = ByNames(names, i_Joint); joint >= 0)
		return {joint, EPartnerRule::Names};
	const std::int64_t joint = ByPlaces(skeleton, names, i_Joint);
	return {joint, joint < 0 ? EPartnerRule::None : EPartnerRule::Places};
}

} // namespace SetupProposal
