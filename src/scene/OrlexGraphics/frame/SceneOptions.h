#pragma once

#include <cstdint>
#include <string>

namespace OrlexGraphics
{

/// What is drawn of the subjects of one class.
struct VSubjectOptions
{
	bool m_bEnabled = true;
	bool m_bAxes = false;
	bool m_bBones = true;
	bool m_bMarkers = true;
	bool m_bSticks = true;
	bool m_bJoints = false;
	bool m_bMissingMarkers = true;
	bool m_bOrigins = true;
	bool m_bSticksDuringGaps = false;
	bool m_bTargets = false;
	bool m_bTargetCovariances = false;
	bool m_bClusters = true;
	bool m_bSkin = true;
	bool m_bSkinXRay = false;

	bool operator==(const VSubjectOptions&) const = default;
};

/// All that QML can switch in a scene. The user interface thread's structure is copied whole to the render thread's
/// once a frame.
struct VSceneOptions
{
	/// The camera grid is shown instead of the free 3D view.
	bool m_bCameraView = false;
	/// The opaque and the transparent pass run.
	bool m_b3D = true;
	/// 3D is drawn through the lens distortion of the overlay camera.
	bool m_bDistort3D = false;
	/// Written by the scene, read by QML.
	bool m_bYUp = false;
	/// Of the 3D over a camera's picture.
	double m_3DOpacity = 1.0;
	/// Device URN of the camera over whose picture the 3D is drawn; empty for none.
	std::string m_OverlayCamera;
	bool m_bGlobalAxis = true;
	bool m_bFloorGrid = true;
	/// Then it is drawn in the transparent pass.
	bool m_bFloorGridIsTranslucent = true;
	bool m_bReconstructionVolume = true;
	/// Metres.
	float m_FloorGridSize = 6.0f;
	bool m_bCameras = true;
	bool m_bCameraAxes = false;
	bool m_bCameraFrustums = true;
	bool m_bCameraRays = false;
	bool m_bCameraMaskGrid = true;
	bool m_bCameraShowRotated = true;
	bool m_bCameraSnap90Degrees = false;
	bool m_bCameraGreyscale = true;
	bool m_bCameraMaximiseGreyscale = false;
	double m_CameraMaximiseGreyscaleFactor = 0.0;
	std::int32_t m_CameraMaximiseGreyscaleHistory = 128;
	bool m_bCameraCentroids = true;
	bool m_bCameraWandSmear = false;
	bool m_bCameraBorder = false;
	bool m_bReconstructions = true;
	bool m_bReconstructedRadius = false;
	float m_ReconstructionScale = 1.0f;
	std::int32_t m_ContributionsType = 0;
	bool m_bMarkerRadius = true;
	bool m_bFillMethod = true;
	bool m_bMarkerTrails = false;
	bool m_bAllowTrailKeySelection = false;
	std::int32_t m_TrailLengthPast = 10;
	std::int32_t m_TrailLengthFuture = 10;
	bool m_bLocators = true;
	bool m_bRigidBodies = true;
	bool m_bFBXScene = true;
	bool m_bThreshold = false;
	bool m_bActiveLabelHalo = false;
	bool m_bSubjectNames = true;
	bool m_bManipulator = true;
	std::string m_SubjectPreset;
	VSubjectOptions m_PropSubject;
	/// The source subject of the retarget panel.
	VSubjectOptions m_LabellingSubject;
	/// The target subject of the retarget panel.
	VSubjectOptions m_SolvingSubject;
	VSubjectOptions m_RetargetingSubject;
	/// QRgb of the clear colour.
	std::uint32_t m_BackgroundColorRGB = 0x202020;
	bool m_bRenderInClipColor = false;
	bool m_bHighlightCurrentSubject = true;
	bool m_bUseCentroidConnectionColourScheme = true;
	std::int32_t m_DebugVideo = 0;
	bool m_bVideo = true;
	bool m_bSelectedReconCount = false;
	/// The manipulator's size on screen, see c_MinManipulatorScale.
	float m_ManipulatorScale = 1.0f;

	bool operator==(const VSceneOptions&) const = default;
};

inline constexpr float c_MinManipulatorScale = 0.2f;
inline constexpr float c_MaxManipulatorScale = 15.0f;

} // namespace OrlexGraphics
