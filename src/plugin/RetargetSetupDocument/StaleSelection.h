#pragma once

class VRetargetSetupCore;

namespace TesselPluginInterface
{
class ISelectionManager;
}

namespace RetargetSetup
{

/// Subjects in whose place others stand.
struct VReplacedSubjects
{
	bool m_bSource = false;
	bool m_bTarget = false;
};

/// Takes out of selection and pre-selection what the document no longer has: its source segments, target segments and
/// targets whose index lies beyond their list, and all of a replaced subject. Otherwise an item of an older subject
/// would come to life with a later one. Items of other kinds and other subjects stay. To be called on each change of
/// the document.
void DropStaleItems(const VRetargetSetupCore& i_rDocument, TesselPluginInterface::ISelectionManager& io_rManager,
    const VReplacedSubjects& i_rReplaced = {});

} // namespace RetargetSetup
