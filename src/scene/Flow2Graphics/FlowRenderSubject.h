#pragma once

#include "CoreOrlexTypes/Subject.h"
#include "CoreOrlexTypes/SubjectApplicationData.h"
#include "CoreOrlexTypes/SubjectState.h"
#include "CoreOrlexTypesUtils/SubjectKinematics.h"
#include "Flow2Graphics/RenderSubjectData.h"
#include "Flow2Graphics/SubjectTypes.h"
#include "OrlexGraphics/overlays/CameraDefinition.h"

#include <QMatrix4x4>
#include <QVector3D>

#include <memory>
#include <optional>
#include <span>
#include <string>
#include <vector>

namespace OrlexGraphics
{
class VSelectionRegistry;
class VSkinCache;
} // namespace OrlexGraphics

namespace Flow2Graphics
{

/// One subject of the scene: evaluates its pose once a frame and fills the arrays that are drawn. Render thread;
/// touches no OpenGL.
class VFlowRenderSubject
{
public:
	/// What a frame says of the subject; null for what it does not.
	struct VPoseData
	{
		/// Without one the subject stays where it was; it shows once it had the first.
		const CoreOrlexTypes::VSubjectDynamicParameters* m_pPose = nullptr;
		/// Without them all markers count as present, at the places where the pose expects them.
		const CoreOrlexTypes::VReconstructionLabelSet* m_pLabels = nullptr;
	};

	/// A subject whose kinematics cannot be built is told of in the log, and stays empty; so is a target that does not
	/// fit its type, which is left out.
	/// @param i_pData null for defaults; may be shorter than the subject
	VFlowRenderSubject(std::shared_ptr<const CoreOrlexTypes::VSubject> i_pSubject,
	    std::shared_ptr<const CoreOrlexTypes::VSubjectApplicationData> i_pData,
	    std::shared_ptr<const ISubjectSelectionMaker> i_pSelectionMaker);
	~VFlowRenderSubject();

	/// Puts on the skins that the cache has now, and takes off those that it has no more.
	/// @return false if one of them is still being loaded: then ask again, until then the subject wears what it wore
	bool BindSkins(OrlexGraphics::VSkinCache& io_rCache);

	void Update(const VPoseData& i_rPoseData, OrlexGraphics::VSelectionRegistry& io_rRegistry,
	    const QMatrix4x4& i_rSceneTransform);

	const CoreOrlexTypes::VSubject& Subject() const { return *m_pSubject; }
	const std::shared_ptr<VRenderSubjectData>& Data() const { return m_pRenderData; }
	const std::shared_ptr<VRenderSubjectMarkerData>& Markers() const { return m_pMarkerData; }

	/// By segment: 1 where all is well, 0 where markers are missing.
	std::span<const float> SegmentHealth() const { return m_SegmentHealth; }
	/// By segment, in the world; empty before the first pose.
	std::span<const QMatrix4x4> SegmentMatrices() const { return m_SegmentMatrices; }

	/// Nothing before the first pose.
	std::optional<OrlexGraphics::VSubjectLabel> Label(bool i_bYUp) const;

private:
	void Build();
	/// @return false if there is no pose yet.
	bool Evaluate(const CoreOrlexTypes::VSubjectDynamicParameters* i_pPose);
	void TakeMatrices(const QMatrix4x4& i_rSceneTransform);
	void FillMarkers(const CoreOrlexTypes::VReconstructionLabelSet* i_pLabels,
	    OrlexGraphics::VSelectionRegistry& io_rRegistry, const QMatrix4x4& i_rSceneTransform);
	void FillSticks();
	void FillTargets(OrlexGraphics::VSelectionRegistry& io_rRegistry, const QMatrix4x4& i_rSceneTransform);
	void FillTarget(
	    std::size_t i_Index, OrlexGraphics::VSelectionRegistry& io_rRegistry, const QMatrix4x4& i_rSceneTransform);
	void CheckHealth(const CoreOrlexTypes::VSubject::VTarget& i_rTarget);
	void FillSegments(OrlexGraphics::VSelectionRegistry& io_rRegistry);
	void FillBone(std::size_t i_Index);
	bool BindMainSkin(OrlexGraphics::VSkinCache& io_rCache);
	bool BindClusterSkins(OrlexGraphics::VSkinCache& io_rCache);
	/// The pose and the health of the segments, for the skins.
	void UpdateSkins();

	const std::shared_ptr<const CoreOrlexTypes::VSubject> m_pSubject;
	const std::shared_ptr<const CoreOrlexTypes::VSubjectApplicationData> m_pData;
	const std::shared_ptr<const ISubjectSelectionMaker> m_pSelectionMaker;
	CoreOrlexTypesUtils::VSubjectKinematics m_Kinematics;
	std::vector<float> m_Radii;
	std::vector<bool> m_Origins;
	/// Targets that are rigid bodies and have kinematics: clusters of markers.
	std::vector<std::size_t> m_Clusters;
	std::vector<std::string> m_SegmentNames;
	std::vector<std::string> m_MarkerNames;

	bool m_bPosed = false;
	std::vector<double> m_State;
	std::vector<QMatrix4x4> m_SegmentMatrices;
	std::vector<CoreGraphics::VSelectionId> m_SegmentIds;
	/// How far from its origin something is drawn under a segment's id.
	std::vector<float> m_Reach;
	std::vector<float> m_SegmentHealth;

	struct VMarkerState
	{
		QVector3D m_Position;
		/// It has a place, seen or expected.
		bool m_bPlaced = false;
		bool m_bPresent = true;
	};
	std::vector<VMarkerState> m_MarkerStates;
	std::vector<Rotation::VVector3> m_ExpectedMarkers;
	std::vector<bool> m_ExpectedValid;

	const std::shared_ptr<VRenderSubjectData> m_pRenderData = std::make_shared<VRenderSubjectData>();
	const std::shared_ptr<VRenderSubjectMarkerData> m_pMarkerData = std::make_shared<VRenderSubjectMarkerData>();
};

} // namespace Flow2Graphics
