#pragma once

/// Once the first QQuickWidget that is shown stands on the screen, prints the clock (monotonic) and the time of the
/// processor that the process has had, in seconds, and quits the application soon after.
void TellFirstPicture();
