#pragma once

class QApplication;

namespace StudioHost
{

/// Dark and calm for the widgets around the panels: greys, orange for what is active, blue for what is chosen.
void ApplyDarkStyle(QApplication& io_rApplication);

} // namespace StudioHost
