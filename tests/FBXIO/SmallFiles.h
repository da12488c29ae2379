#pragma once

#include "FbxFileBuilder.h"

#include <functional>
#include <random>

/// Small files with all that the reader knows, and ways to damage them.
namespace FbxTest
{

struct VSmallFile
{
	const char* m_pName;
	VTestForm m_Form;
	/// As plain arrays: a change of one byte is a change of one number.
	bool m_bPlain = false;
};

inline constexpr VSmallFile c_SmallFiles[]{{"Binary6100", c_Forms[0]}, {"Binary7400", c_Forms[1]},
    {"Binary7500", c_Forms[2]}, {"Text6100", c_Forms[3]}, {"Text7400", c_Forms[4]},
    {"PlainArrays", {"Binary7700", EForm::Binary, 7700}, true}, {"Binary5800", {"Binary5800", EForm::Binary, 5800}}};

/// Two triangles with every kind of layer, two materials, a texture, on two bones.
/// @param i_rPicture stands in the file, since version 6
std::vector<VTestRecord> SmallRecords(const VSmallFile& i_rFile, const std::string& i_rPicture = {});

/// Some changes of bytes: bits, numbers that are often wrong, pieces that are lost, doubled or put elsewhere.
std::string MutateBytes(std::string i_Bytes, std::mt19937& io_rRandom);

/// Some changes of records: lengths, ids, connections, counts, numbers, arrays packed in other ways, nesting, names and
/// values.
std::vector<VTestRecord> MutateRecords(std::vector<VTestRecord> i_Records, std::mt19937& io_rRandom);

/// Runs it on a thread with a stack of 512 KiB, and waits for it.
void OnSmallStack(const std::function<void()>& i_rRun);

} // namespace FbxTest
