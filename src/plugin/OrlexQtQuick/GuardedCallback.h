#pragma once

#include "NVX/Shared.h"

#include <QPointer>

#include <functional>
#include <utility>

namespace OrlexQtQuick
{

/// A callback for a signal that calls a member of a widget while the widget lives; the signal drops it after. For
/// objects that others own by plain pointers, so that no weak pointer can be had of them.
template <typename T, typename TBase, typename... VArguments>
std::function<void(const VArguments&...)> Guarded(T* i_pObject, void (TBase::*i_pMember)(VArguments...))
{
	return [pObject = QPointer<T>(i_pObject), i_pMember](const VArguments&... i_rArguments)
	{
		if (!pObject)
			throw NVX::VDeregisterWeakCallbackException();
		(pObject.data()->*i_pMember)(i_rArguments...);
	};
}

} // namespace OrlexQtQuick
