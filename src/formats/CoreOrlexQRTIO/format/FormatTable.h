#pragma once

#include "CoreOrlexQRTIO/format/Format.h"

namespace CoreOrlexQRTIO::Format
{

inline constexpr std::uint32_t c_Many = UtilsRapidXml::c_Unbounded;

namespace KinematicModel
{
inline constexpr VElement c_Element{"KinematicModel", "The root node of a kinematic model (QRK)"};

inline constexpr VAttribute c_Model{"MODEL",
    "The name of the original model template that is used to generate this file (usually present in a QRK only)",
    c_String};
inline constexpr VAttribute c_Version{"VERSION", "The version number of the QRT language used in this file", c_String};
inline constexpr VAttribute c_ModelVersion{
    "MODEL-VERSION", "Generic version number to indicate an update to a model", c_String, false, c_3_5};
inline constexpr VAttribute c_RetargetSourceTemplate{
    "RETARGET-SOURCE-TEMPLATE", "Template used for retargeting", c_String, false, c_3_5};
inline constexpr VAttribute c_RetargetSourceSubject{
    "RETARGET-SOURCE-SUBJECT", "Subject used for retargeting", c_String, false, c_3_5};
inline constexpr VAttribute c_Development{"DEVELOPMENT", "Whether this QRT version is still in development.", c_String};

inline constexpr VElement c_Parameters{"Parameters",
    "The section of the QRT/QRK containing the (variable) parameters that describe the model geometry", 0, 1};
inline constexpr VElement c_Skeleton{"Skeleton", "The skeletal hierarchy part of the model", 1, 1};
inline constexpr VElement c_MarkerSet{"MarkerSet", "The section of the model that describes a marker set", 1, 1};
inline constexpr VElement c_TargetSet{
    "TargetSet", "The section of the model that describes the target set", 0, 1, c_3_0};
inline constexpr VElement c_Skin{"Skin", "The skin to apply when rendering the skeleton.", 0, 1, c_3_3};
inline constexpr VElement c_SubjectDynamicSubspace{
    "SubjectDynamicSubspace", "Subject dynamic subspace specification", 0, 1, c_3_5};
} // namespace KinematicModel

namespace Parameters
{
inline constexpr VElement c_StaticParameter{"StaticParameter",
    "An individual parameter for describing a physically measured (constant) aspect of the model geometry", 0, c_Many,
    c_2_0};
inline constexpr VElement c_Parameter{
    "Parameter", "An individual parameter for describing a variable aspect of the model geometry"};
} // namespace Parameters

namespace StaticParameter
{
inline constexpr VAttribute c_Name{"NAME", "The name of this parameter", c_Id, true};
inline constexpr VAttribute c_Value{"VALUE", "The value of this parameter (in QRT units)", c_Double};
inline constexpr VAttribute c_Prior{"PRIOR", "The prior value for this parameter (in QRT units)", c_Double};
inline constexpr VAttribute c_Expression{
    "EXPRESSION", "The calculated prior expression for this parameter (in QRT units)", c_String, false, c_2_0};
inline constexpr VAttribute c_Hidden{
    "HIDDEN", "Specifies whether this parameter will be displayed to the user", c_String, false, c_2_0};
inline constexpr VAttribute c_Advanced{
    "ADVANCED", "Specifies whether this parameter should be listed in the advanced section", c_String, false, c_2_0};
inline constexpr VAttribute c_ReadOnly{
    "READONLY", "Specifies whether the user may edit this parameter", c_String, false, c_2_0};
inline constexpr VAttribute c_Required{
    "REQUIRED", "Specifies whether the user must provide a value for this parameter", c_String, false, c_2_0};
inline constexpr VAttribute c_Quantity{"QUANTITY", "The parameter quantity", "TYPE_QUANTITY", false, c_2_0};
} // namespace StaticParameter

namespace Parameter
{
inline constexpr VAttribute c_Name{"NAME", "The name of this parameter", c_Id, true};
inline constexpr VAttribute c_Value{"VALUE", "The value of this parameter (in QRT units)", c_Double, true};
inline constexpr VAttribute c_Prior{
    "PRIOR", "The prior value for this parameter (in QRT units)", c_Double, false, c_2_0};
inline constexpr VAttribute c_StandardDeviation{
    "SD", "The standard deviation (SD) in this parameter (in QRT units)", c_Double, false, c_2_0};
inline constexpr VAttribute c_Hidden{
    "HIDDEN", "Specifies whether this parameter will be displayed to the user", c_String, false, c_2_0};
} // namespace Parameter

namespace Skeleton
{
inline constexpr VAttribute c_Name{"NAME", "DEPRECATED", c_String};
inline constexpr VAttribute c_Colour{"RGB", "The colour of this subject", c_String};
inline constexpr VElement c_Segment{"Segment", "A single segment in the skeletal hierarchy"};
} // namespace Skeleton

namespace Segment
{
inline constexpr VAttribute c_Name{"NAME", "The name of this segment", c_Id, true};
inline constexpr VAttribute c_Position{"POSITION", "DEPRECATED", c_String, false, c_1_0, c_1_0};
inline constexpr VAttribute c_Opacity{"OPACITY", "The opacity of this segment", c_Double, false, c_3_0};
inline constexpr VAttribute c_Orientation{"ORIENTATION", "DEPRECATED", c_String, false, c_1_0, c_1_0};
inline constexpr VAttribute c_Bounds{"BOUNDS",
    "A pair of vectors describing the upper and lower corners of the box used for visualising this segment", c_String};
inline constexpr VAttribute c_Mass{
    "MASS", "The mass of this segment as a proportion of the total subject mass", c_String, false, c_2_0};
inline constexpr VAttribute c_MassCentre{"MASS-CENTRE",
    "The location of this segments centre of mass in the local co-ordinate system", c_String, false, c_2_0};
inline constexpr VAttribute c_Inertia{
    "INERTIA", "The radii of gyration of this segment about the local co-ordinate system axes", c_String, false, c_2_0};
inline constexpr VAttribute c_Colour{"RGB", "The colour of this segment", c_String};
inline constexpr VAttribute c_Context{
    "CONTEXT", "The context of this segment (e.g. Left, Right)", c_String, false, c_2_0};
inline constexpr VAttribute c_Hidden{"HIDDEN", "Whether the segment is hidden or visible", c_String, false, c_3_0};
inline constexpr VAttribute c_DrawEndRatio{"DRAW-END-RATIO",
    "The ratio between the size of the start and end of the geometry used to represent the segment", c_Double, false,
    c_3_0};
inline constexpr VAttribute c_DrawHeight{"DRAW-HEIGHT",
    "A multiplier applied to the height of the geometry used to represent the segment", c_Double, false, c_3_0};
inline constexpr VAttribute c_DrawTwist{
    "DRAW-TWIST", "The rotation to apply to the geometry tat represents the segment", c_Double, false, c_3_0};
inline constexpr VAttribute c_DrawWidth{"DRAW-WIDTH",
    "A multiplier applied to the width of the geometry used to represent the segment", c_Double, false, c_3_0};
inline constexpr VAttribute c_Part{"PART",
    "The part of the body this segment represents based on a specific list of body parts", c_String, false, c_3_0};
inline constexpr VAttribute c_Covariance{"COVARIANCE", "DEPRECATED", c_String};
inline constexpr VAttribute c_Size{"SIZE", "DEPRECATED", c_String};
inline constexpr VAttribute c_DrawStyle{"DRAW-STYLE",
    "Specifies what type of geometry should be used to draw the segment", "TYPE_DRAW-STYLE", false, c_3_0};
inline constexpr VAttribute c_DrawShading{
    "DRAW-SHADING", "Specifies how the segment should be rendered", "TYPE_DRAW-SHADING", false, c_3_0};
} // namespace Segment

namespace Joint
{
inline constexpr VElement c_Ball{"JointBall", "A ball and socket joint with 3 rotational degrees of freedom only"};
inline constexpr VElement c_Dummy{"JointDummy", "A Dummy joint, i.e. one with no degrees of freedom"};
inline constexpr VElement c_Free{"JointFree", "A free joint with 6 degrees of freedom"};
inline constexpr VElement c_HardySpicer{
    "JointHardySpicer", "A Hardy Spicer joint (one that has two intersecting axes of rotation)"};
inline constexpr VElement c_Hinge{"JointHinge", "A hinge joint"};
inline constexpr VElement c_Slider{"JointSlider", "A slider (or prismatic) joint"};

inline constexpr VAttribute c_Name{"NAME", "The name of this joint", c_Id};
inline constexpr VAttribute c_PreOrientation{"PRE-ORIENTATION",
    "The orientation of this joint in the co-ordinate frame of the parent segment", c_String, false, c_2_0};
inline constexpr VAttribute c_PrePosition{"PRE-POSITION",
    "The position of this joint in the co-ordinate frame of the parent segment", c_String, false, c_2_0};
inline constexpr VAttribute c_InversePostOrientation{"INVERSE-POST-ORIENTATION",
    "The inverse orientation of the child segment in the co-ordinate frame of this joint", c_String, false, c_3_2};
inline constexpr VAttribute c_InversePostPosition{"INVERSE-POST-POSITION",
    "The inverse position of the child segment in the co-ordinate frame of this joint", c_String, false, c_3_2};
inline constexpr VAttribute c_PostOrientation{"POST-ORIENTATION",
    "The orientation of the child segment in the co-ordinate frame of this joint", c_String, false, c_2_0, c_3_1};
inline constexpr VAttribute c_PostPosition{"POST-POSITION",
    "The position of the child segment in the co-ordinate frame of this joint", c_String, false, c_2_0, c_3_1};
inline constexpr VAttribute c_EditPoseMean{"EDIT_POSE_MEAN", "DEPRECATED", c_String};
inline constexpr VAttribute c_TPose{"T-POSE", "DEPRECATED", c_String};

inline constexpr VAttribute c_Bounds{"BOUNDS", "DEPRECATED", c_String};
inline constexpr VAttribute c_Mean{"MEAN", "The mean state of this joint", c_String};
inline constexpr VAttribute c_Covariance{"COVARIANCE", "The covariance in the mean state of this joint", c_String};
inline constexpr VAttribute c_T{"T",
    "The state of this joint in the T-pose. A placeholder (*) indicates an unconstrained degree of freedom", c_String};
inline constexpr VAttribute c_Signs{
    "SIGNS", "A list of either + or - indicating the sign of the state output from this joint", c_String};
inline constexpr VAttribute c_Labels{
    "LABELS", "A list of text labels to be used for identifying the state output from this joint", c_String};
inline constexpr VAttribute c_RangeCentringState{"RANGE-CENTRING-STATE",
    "Joint type dependent transformation used to centre joint state data in the middle of the range space", c_String,
    false, c_3_0};
inline constexpr VAttribute c_RangeMatrix{
    "RANGE-MATRIX", "Covariance-like matrix defining the joint ranges", c_String, false, c_3_0};

inline constexpr VElement c_JointTemplate{"JointTemplate", "Stores the skeleton TEMPLATE", 0, 1, c_2_0};

inline constexpr VAttribute c_EulerOrder{"EULER-ORDER",
    "The Euler angle order to be used when displaying the state output from this joint", "TYPE_EULER-ORDER"};
inline constexpr VAttribute c_AxisPair{"AXIS-PAIR", "The pair of axes of this (Hardy Spicer) joint", c_String};
inline constexpr VAttribute c_Axis{"AXIS", "The axis of this (hinge) joint", c_String};
} // namespace Joint

namespace JointTemplate
{
inline constexpr VAttribute c_Mean{"MEAN", "Mean joint state in the uncalibrated subject (template)", c_String};
inline constexpr VAttribute c_Covariance{
    "COVARIANCE", "Covariance of the joint state in the uncalibrated subject (template)", c_String};
inline constexpr VAttribute c_TPoseMean{
    "TPOSE-MEAN", "Mean joint state in the T-pose subject (template)", c_String, false, c_2_1};
inline constexpr VAttribute c_TPoseCovariance{
    "TPOSE-COVARIANCE", "Covariance of the joint state in the T-pose subject (template)", c_String, false, c_2_1};
inline constexpr VAttribute c_BindPose{"BIND-POSE", "Bind pose for retargeting", c_String, false, c_3_5};
inline constexpr VAttribute c_PreOrientation{
    "PRE-ORIENTATION", "The orientation of this joint in the co-ordinate frame of the parent segment", c_String};
inline constexpr VAttribute c_PrePosition{
    "PRE-POSITION", "The position of this joint in the co-ordinate frame of the parent segment", c_String};
inline constexpr VAttribute c_InversePostOrientation{"INVERSE-POST-ORIENTATION",
    "The inverse orientation of this joint in the co-ordinate frame of the this segment", c_String, false, c_3_2};
inline constexpr VAttribute c_InversePostPosition{"INVERSE-POST-POSITION",
    "The inverse position of the child segment in the co-ordinate frame of this joint", c_String, false, c_3_2};
inline constexpr VAttribute c_PostOrientation{"POST-ORIENTATION",
    "The orientation of this joint in the co-ordinate frame of the this segment", c_String, false, c_2_0, c_3_1};
inline constexpr VAttribute c_PostPosition{"POST-POSITION",
    "The position of the child segment in the co-ordinate frame of this joint", c_String, false, c_2_0, c_3_1};
inline constexpr VAttribute c_RangeCentringState{"RANGE-CENTRING-STATE",
    "Joint type dependent transformation used to centre joint state data in the middle of the range space in the "
    "uncalibrated subject",
    c_String, false, c_3_0};
inline constexpr VAttribute c_RangeMatrix{"RANGE-MATRIX",
    "Covariance-like matrix defining the joint ranges in the uncalibrated subject", c_String, false, c_3_0};
} // namespace JointTemplate

namespace MarkerSet
{
inline constexpr VAttribute c_Name{"NAME", "The name of this marker set", c_String, false, c_1_0};
inline constexpr VElement c_Markers{"Markers", "The section of the marker set containing the markers used", 1, 1};
inline constexpr VElement c_Sticks{
    "Sticks", "The section of the marker set containing sticks drawn between markers for visualisation purposes", 0, 1};
inline constexpr VElement c_Marker{"Marker", "A single marker"};
inline constexpr VElement c_Stick{"Stick", "A single stick"};
} // namespace MarkerSet

namespace Marker
{
inline constexpr VAttribute c_Name{"NAME", "The name of this marker", c_Id, true};
inline constexpr VAttribute c_Segment{
    "SEGMENT", "The segment to which this marker is attached", c_IdRef, false, {}, c_2_6};
inline constexpr VAttribute c_Position{"POSITION",
    "The position of this marker in the co-ordinate frame of the segment to which it is attached", c_String, false, {},
    c_2_6};
inline constexpr VAttribute c_Covariance{
    "COVARIANCE", "The measurement covariance in the position of this marker", c_String, false, {}, c_2_6};
inline constexpr VAttribute c_Radius{"RADIUS", "The radius of this marker", c_Double};
inline constexpr VAttribute c_Colour{"RGB", "The colour of this marker", c_String};
inline constexpr VAttribute c_Descriptor{"DESCRIPTOR", "DEPRECATED", c_String, false, c_2_0, c_2_5};
inline constexpr VElement c_MarkerTemplate{"MarkerTemplate", "Stores the skeleton TEMPLATE", 0, 1, c_2_0, c_2_6};
inline constexpr VAttribute c_Status{"STATUS",
    "The status of this marker: whether it is required or optional and whether it has been detected", "TYPE_STATUS",
    false, c_2_0};
inline constexpr VAttribute c_ViewNormal{"VIEW-NORMAL",
    "If the marker is only seen from certain directions, this is the axis of the visibility cone", c_String, false,
    c_2_6, c_2_6};
inline constexpr VAttribute c_ViewAngle{
    "VIEW-ANGLE", "The angle in radians that describes the width of the visibility cone", c_Double, false, c_2_6};
} // namespace Marker

namespace MarkerTemplate
{
inline constexpr VAttribute c_Position{
    "POSITION", "The position of this marker in the co-ordinate frame of the parent segment", c_String};
inline constexpr VAttribute c_Covariance{"COVARIANCE", "Covariance of the uncalibrated marker (template)", c_String};
inline constexpr VAttribute c_PlacementCovariance{"PLACEMENT-COVARIANCE", "DEPRECATED", c_String, false, c_2_1, c_2_6};
} // namespace MarkerTemplate

namespace Stick
{
inline constexpr VAttribute c_Marker1{"MARKER1", "The name of the first marker defining this stick", c_IdRef, true};
inline constexpr VAttribute c_Marker2{"MARKER2", "The name of the second marker defining this stick", c_IdRef, true};
inline constexpr VAttribute c_Colour{"RGB", "The colour of this stick", c_String, false, c_1_0, c_2_6};
inline constexpr VAttribute c_Colour1{"RGB1", "The colour of the first end of the stick", c_String, false, c_3_0};
inline constexpr VAttribute c_Colour2{"RGB2", "The colour of the second end of the stick", c_String, false, c_3_0};
} // namespace Stick

namespace TargetSet
{
inline constexpr VElement c_Targets{"Targets", "The section of the target set containing the targets", 1, 1};
} // namespace TargetSet

namespace Target
{
inline constexpr VElement c_Line{"TargetLocalLineToWorldPoint", "A target mapping a local line to a world point"};
inline constexpr VElement c_Plane{"TargetLocalPlaneToWorldPoint", "A target mapping a local plane to a world point"};
inline constexpr VElement c_Point{"TargetLocalPointToWorldPoint", "A simple marker attached to a parent segment"};
inline constexpr VElement c_RigidBody{"TargetRigidBody", "Defines a rigid cluster of markers attached to a segment"};
inline constexpr VElement c_Rotation{"TargetLocalRotationToWorldRotation", "Align a segment with a world orientation"};
inline constexpr VElement c_Direction{
    "TargetLocalDirectionToWorldDirection", "Align a segment to a direction constraint", 0, c_Many, c_3_5};

inline constexpr VAttribute c_LineCovariance{"COVARIANCE", "Covariance of the line origin and direction", c_String};
inline constexpr VAttribute c_PlaneCovariance{"COVARIANCE", "Covariance of the plane origin and covariance", c_String};
inline constexpr VAttribute c_PointCovariance{
    "COVARIANCE", "Measurement covariance in the position of the target", c_String};
inline constexpr VAttribute c_PlacementCovariance{
    "PLACEMENT-COVARIANCE", "Marker placement covariance", c_String, false, c_3_3};
inline constexpr VAttribute c_LineDirection{"DIRECTION", "Direction of the line", c_String, true};
inline constexpr VAttribute c_FillGaps{"FILL-GAPS", "Whether gaps in the marker data are filled", c_String};
inline constexpr VAttribute c_Gaussian{"GAUSSIAN", "Whether this is a Gaussian target", c_String};
inline constexpr VAttribute c_Hidden{
    "HIDDEN", "Specifies whether the target should be visible to the user or hidden", c_String, true};
inline constexpr VAttribute c_Name{"NAME", "The name of this target", c_String};
inline constexpr VAttribute c_Normal{"NORMAL", "Normal to the plane", c_String};
inline constexpr VAttribute c_Marker{"MARKER", "The marker associated with this target", c_IdRef, true};
inline constexpr VAttribute c_Opacity{"OPACITY", "How transparent the target should be when drawn", c_Double};
inline constexpr VAttribute c_LineOrigin{"ORIGIN", "Origin of the line", c_String, true};
inline constexpr VAttribute c_PlaneOrigin{"ORIGIN", "Origin of the plane", c_String, true};
inline constexpr VAttribute c_PointPosition{
    "POSITION", "Position of the point in the co-ordinate system of the segment", c_String, true};
inline constexpr VAttribute c_RigidBodyPosition{"POSITION",
    "The position of the rigid body  in the co-ordinate frame of the (fake) segment to which it is attached", c_String,
    true};
inline constexpr VAttribute c_RigidBodyOrientation{"ORIENTATION",
    "The orientation of  the rigid body  in the co-ordinate frame of the (fake) segment to which it is attached",
    c_String, false, c_3_1};
inline constexpr VAttribute c_RigidBodyCovariance{"COVARIANCE",
    "The covariance of  the rigid body  in the co-ordinate frame of the (fake) segment to which it is attached",
    c_String, false, c_3_1};
inline constexpr VAttribute c_CalibrationWeight{
    "CALIBRATION-WEIGHT", "Non-negative weight for subject scale estimation", c_Double, false, c_3_5};
inline constexpr VAttribute c_RotationState{
    "ROTATION", "The ROTATION offset of the target observation", c_String, false, c_3_4};
inline constexpr VAttribute c_DirectionState{
    "DIRECTION", "The DIRECTION offset of the target observation", c_String, false, c_3_5};
inline constexpr VAttribute c_RotationWeight{
    "WEIGHT", "The amount of influence the target should have in the solution", c_Double, true, c_3_4};
inline constexpr VAttribute c_DirectionWeight{
    "WEIGHT", "The amount of influence the target should have in the solution", c_Double, true, c_3_5};
inline constexpr VAttribute c_RotationObservation{
    "ROTATION-OBSERVATION", "The observation associated with this target", c_String, true, c_3_4};
inline constexpr VAttribute c_DirectionObservation{
    "DIRECTION-OBSERVATION", "The observation associated with this target", c_String, true, c_3_5};
inline constexpr VAttribute c_Axis{
    "AXIS", "The axis of a target constrained on two axis- behaving like a hinge", c_String, false, c_3_5};
inline constexpr VAttribute c_AxisPair{"AXIS-PAIR",
    "The pair of axes of a target constrained on a single axis- behaving like a Hardy Spicer", c_String, false, c_3_5};
inline constexpr VAttribute c_Colour{"RGB", "The colour of this target", c_String};
inline constexpr VAttribute c_Segment{"SEGMENT", "The segment to which the target is attached", c_IdRef, true};
inline constexpr VAttribute c_MarkerWeight{
    "WEIGHT", "The amount of influence the target should have in the solution", c_Double, true};
inline constexpr VAttribute c_ViewNormal{
    "VIEW-NORMAL", "Direction the target is facing in the co-ordinate system of the segment", c_String};
inline constexpr VAttribute c_DrawStyle{"DRAW-STYLE", "How the target should be drawn", "TYPE_TARGET-DRAW-STYLE"};

inline constexpr VElement c_LineTemplate{"TargetLocalLineToWorldPointTemplate", "Stores the skeleton template", 1, 1};
inline constexpr VElement c_PlaneTemplate{"TargetLocalPlaneToWorldPointTemplate", "Stores the skeleton template", 1, 1};
inline constexpr VElement c_PointTemplate{"TargetLocalPointToWorldPointTemplate", "Stores the skeleton template", 1, 1};
inline constexpr VAttribute c_LineTemplateCovariance{
    "COVARIANCE", "Template covariance of the line origin and direction", c_String};
inline constexpr VAttribute c_PlaneTemplateCovariance{
    "COVARIANCE", "Template covariance of the plane origin and covariance", c_String};
inline constexpr VAttribute c_PointTemplateCovariance{
    "COVARIANCE", "Template measurement covariance in the position of the target", c_String};

inline constexpr VElement c_RigidBodyMarker{"RigidBodyMarker", "Defines a marker part of a rigid body target."};
} // namespace Target

namespace RigidBodyMarker
{
inline constexpr VAttribute c_Name{"NAME", "The name of this marker", c_IdRef, true};
inline constexpr VAttribute c_Position{"POSITION", "The position of the marker within the rigid body", c_String, true};
inline constexpr VAttribute c_Covariance{
    "COVARIANCE", "The covariances of the position of the marker within the rigid body", c_String};
inline constexpr VAttribute c_ViewNormal{
    "VIEW-NORMAL", "Direction the marker is facing in the co-ordinate system of the segment", c_String};
} // namespace RigidBodyMarker

namespace Skin
{
inline constexpr VAttribute c_Name{"NAME", "Skin name", c_String};
inline constexpr VAttribute c_ColourA{"RGB1", "The primary colour applied to the skin", c_String};
inline constexpr VAttribute c_ColourB{"RGB2", "The secondary colour applied to the skin", c_String};
} // namespace Skin

namespace Subspace
{
inline constexpr VElement c_PcaControlledParams{
    "PcaControlledParams", "A pca chunk controlling a group of joints ", 0, c_Many, c_3_5};
inline constexpr VAttribute c_Name{"NAME", "Limb name", c_String, true, c_3_5};
inline constexpr VAttribute c_Version{"VERSION", "Version", c_String, true, c_3_5};
inline constexpr VAttribute c_JointNames{"JOINT-NAMES", "Joint names", c_String, true, c_3_5};
inline constexpr VAttribute c_JointParamsMean{"JOINT-PARAMS-MEAN", "Mean joint parameters", c_String, true, c_3_5};
inline constexpr VElement c_PrincipalComponent{
    "PrincipalComponent", "A basis vector for a subject dynamic subspace", 0, c_Many, c_3_5};
} // namespace Subspace

namespace PrincipalComponent
{
inline constexpr VAttribute c_Name{"NAME", "Action name", c_String, false, c_3_5};
inline constexpr VAttribute c_JointParams{"JOINT-PARAMS", "PCA basis vector", c_String, true, c_3_5};
inline constexpr VAttribute c_SqrtEigenvalue{
    "SQRT-EIGENVALUE", "Square-root of the eigenvalue for this component", c_Double, true, c_3_5};
inline constexpr VAttribute c_LowerBound{"LOWER-BOUND", "Lower bound on the PCA coefficient", c_Double, true, c_3_5};
inline constexpr VAttribute c_UpperBound{"UPPER-BOUND", "Upper bound on the PCA coefficient", c_Double, true, c_3_5};
inline constexpr VAttribute c_TemporalDerivativeSd{"TEMPORAL-DERIVATIVE-SD",
    "Standard deviation of the temporal derivative  of the PCA coeffficient", c_Double, true, c_3_5};
} // namespace PrincipalComponent

} // namespace CoreOrlexQRTIO::Format
