#pragma once

#include "NVX/ISelectionItem.h"

#include <QVector3D>

#include <cstdint>
#include <string>

namespace OrlexGraphics
{

/// A capture camera as the overlay shows it.
struct VCameraDefinition
{
	std::string m_DeviceURN;
	std::uint32_t m_UserId = 0;
	/// Millimetres.
	QVector3D m_Position;
	bool m_bCalibrated = false;
};

/// A name that stands beside a subject or a prop.
struct VSubjectLabel
{
	std::string m_Name;
	/// Millimetres.
	QVector3D m_Position;
	NVX::ISelectionItem m_Item;
};

} // namespace OrlexGraphics
