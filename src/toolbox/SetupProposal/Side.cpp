#include "SetupProposal/Side.h"

#include "SetupProposal/NameWords.h"

#include <algorithm>

namespace SetupProposal
{
namespace
{

struct VSideWords
{
	std::string_view m_Left;
	std::string_view m_Right;
	bool m_bWeak = false;
};

constexpr VSideWords c_SideWords[] = {
    {"left", "right"},
    {"l", "r"},
    {"lft", "rgt"},
    {"lt", "rt"},
    {"links", "rechts"},
    {"linke", "rechte"},
    {"linker", "rechter"},
    {"linkes", "rechtes"},
    {"gauche", "droite"},
    {"gauche", "droit"},
    {"izquierda", "derecha"},
    {"izquierdo", "derecho"},
    {"sinistra", "destra"},
    {"sinistro", "destro"},
    {"esquerda", "direita"},
    {"esquerdo", "direito"},
    {"hidari", "migi"},
    {"左", "右"},
    {"li", "re", true},
    {"g", "d", true},
    {"i", "d", true},
    {"s", "d", true},
    {"e", "d", true},
    {"izq", "der", true},
    {"sx", "dx", true},
    {"esq", "dir", true},
};

} // namespace

ESide SideOfWord(std::string_view i_Word, bool* o_pbWeak)
{
	for (const VSideWords& rRow : c_SideWords)
		if (i_Word == rRow.m_Left || i_Word == rRow.m_Right)
		{
			if (o_pbWeak)
				*o_pbWeak = rRow.m_bWeak;
			return i_Word == rRow.m_Left ? ESide::Left : ESide::Right;
		}
	return ESide::None;
}

ESide SideOfName(std::string_view i_Name)
{
	return WordsOf(i_Name).m_Side;
}

} // namespace SetupProposal
