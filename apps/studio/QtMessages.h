#pragma once

namespace StudioHost
{

/// What Qt and its libraries print goes to the log, category "Qt". Fatal messages still end the program.
void SendQtMessagesToLog();

} // namespace StudioHost
