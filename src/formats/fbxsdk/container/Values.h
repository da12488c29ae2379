#pragma once

#include "fbxsdk/container/ElementTree.h"

namespace FbxFormat
{

enum class EValueKind
{
	None,
	Integer,
	Real,
	/// Quoted text, or raw bytes.
	Text,
	/// Text without quotes that is no number.
	Word,
	/// See ReadArray.
	Array
};

struct VValue
{
	EValueKind m_Kind = EValueKind::None;
	std::int64_t m_Integer = 0;
	double m_Real = 0.0;
	/// As it stands in the file: of the text form with its escapes.
	std::string_view m_Text;

	/// Numbers of either kind; anything else gives the default.
	double AsReal(double i_Default = 0.0) const;
	std::int64_t AsInteger(std::int64_t i_Default = 0) const;
};

/// Goes through the values of one record.
class VValueCursor
{
public:
	VValueCursor(const VElementTree& i_rTree, VElementIndex i_Element);

	/// The next value; of kind None if there is none left.
	VValue Next();

	/// Passes over the next values without looking at them.
	void Skip(int i_Count);

private:
	const char* m_p;
	const char* m_pEnd;
	EValueForm m_Form;
};

/// The value at that place of a record, counted from 0; of kind None if there are not so many.
VValue ValueAt(const VElementTree& i_rTree, VElementIndex i_Element, int i_Place);

/// A number of the text form, "1.#INF", "nan(ind)" and their kin included; kind Word if it is none.
VValue ParseNumber(std::string_view i_Text);

} // namespace FbxFormat
