#pragma once

#include "CoreOrlexQRTIO/SubjectQRTExtras.h"
#include "CoreOrlexTypes/SubjectParametrised.h"

#include <vector>

namespace RetargetSetup
{

/// A subject's T-pose constraints, one value for each degree of freedom, taken apart into the shares of its joints, so
/// that they can be put together again after joints have changed their size.
class VTPoseShares
{
public:
	/// The list holds the shares of the joints that the extras tell, or else one for every joint. A list of another
	/// length cannot be told apart; Restore then leaves it alone.
	VTPoseShares(
	    const CoreOrlexTypes::VSubjectParametrised& i_rSubject, const CoreOrlexQRTIO::VSubjectQRTExtras& i_rExtras);

	/// Puts the shares of the joints that kept their size together. A joint that changed it loses its share; where
	/// every joint has one it gets a share of values that are not set.
	void Restore(
	    CoreOrlexTypes::VSubjectParametrised& io_rSubject, CoreOrlexQRTIO::VSubjectQRTExtras& io_rExtras) const;

private:
	enum class ELayout
	{
		EUnknown,
		EEveryJoint,
		EJointsOfExtras
	};

	ELayout m_Layout = ELayout::EUnknown;
	/// Parallel to the segments.
	std::vector<std::vector<double>> m_Shares;
};

} // namespace RetargetSetup
