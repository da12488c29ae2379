#pragma once

namespace CoreOrlexQRTIO
{

/// What a skeleton file has and the subject types have no field for, so that a file that is read and written again
/// keeps it.
struct VSubjectQRTExtras
{
};

} // namespace CoreOrlexQRTIO
