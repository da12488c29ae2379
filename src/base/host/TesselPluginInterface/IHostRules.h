#pragma once

#include "TesselPluginInterface/IApplicationObject.h"

#include <memory>
#include <string>

namespace TesselPluginInterface
{

/// How a host wants things done where a rule has a plain form and one that fits more characters. The defaults are the
/// plain forms.
struct VHostRules
{
	/// A target subject that is newly made stands as its bones do in the FBX file, not as its joints alone place it.
	bool m_bPoseFromFile = false;
	/// With joint symmetry a pose whose two sides' frames are no mirror images of each other mirrors its change, not
	/// itself.
	bool m_bMirrorChange = false;
	/// What files that were written here have and what harms nothing is told as details, not as warnings: the
	/// attributes xmlns:* and xsi:*, and a name that a marker and a segment share, since performer and character name a
	/// segment alike.
	bool m_bOwnFormsAreDetails = false;
	/// A pair of segments that has a target of a kind gets no second one of that kind.
	bool m_bEachPairOnce = false;
	/// A segment whose name differs from its partner's in more than the rule for names knows finds it by words for
	/// sides anywhere in the names, or by its place.
	bool m_bPartnersBySides = false;
	/// What edits replace is kept, since the host offers to undo them. Asked when the module makes its panel.
	bool m_bKeepsHistory = false;
	/// The wheel of the mouse goes nearer and farther in the fixed views of the preview, too.
	bool m_bWheelInFixedViews = false;
	/// The skin of an FBX file that is opened from elsewhere is looked for in its own folder, too.
	bool m_bSkinBesideFile = false;
};

/// What a host may give beyond the services that every host gives: the application object of such a host implements
/// this, too. Without it nothing is asked and every rule has its plain form.
class IHostRules
{
public:
	virtual ~IHostRules() = default;

	/// Asked each time that it matters, so that a preference may change it.
	virtual VHostRules Rules() const = 0;

	/// Called before a command replaces a target subject that has changes which are not saved. May show a dialog, run
	/// an event loop and save.
	/// @param i_rAction what the operator wants to do, as the beginning of a sentence: "Create Target Subject".
	/// @return false: the command ends with no change.
	virtual bool MayReplaceTargetSubject(const std::string& i_rAction) = 0;

	/// Called before a save overwrites the target subject's file, if that holds something else than what was last
	/// loaded from it or saved to it. May show a dialog.
	/// @return false: the file stays as it is.
	virtual bool MayOverwriteChangedFile(const std::string& /*i_rPath*/) { return true; }
};

/// Null for a host that gives none.
inline std::shared_ptr<IHostRules> HostRulesOf(const std::shared_ptr<IApplicationObject>& i_rpApplication)
{
	return std::dynamic_pointer_cast<IHostRules>(i_rpApplication);
}

} // namespace TesselPluginInterface
