#pragma once

class QWidget;

namespace StudioHost
{

/// Puts a dialog into the lower left corner of its window, and makes it no higher than leaves the view to be seen: over
/// what a dialog has no use for.
void StandBesideView(QWidget& io_rDialog);

} // namespace StudioHost
