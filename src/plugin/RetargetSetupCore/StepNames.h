#pragma once

/// What the edits of the document are called behind "Undo" and "Redo". The commands that ask before work is lost ask by
/// these names, too.
namespace RetargetSetup::Steps
{

inline constexpr const char* c_Create = "Create Target Subject";
inline constexpr const char* c_New = "New Retarget Subject";
inline constexpr const char* c_Load = "Load";
inline constexpr const char* c_AddTarget = "Add Target";
inline constexpr const char* c_ProposeTargets = "Propose Targets";
inline constexpr const char* c_Align = "Align to Source";
inline constexpr const char* c_RemoveTarget = "Remove Target";
inline constexpr const char* c_UpdateTargets = "Update Targets";
inline constexpr const char* c_CreateAllJoints = "Create All Joints";
inline constexpr const char* c_RemoveJoint = "Remove Joint";
inline constexpr const char* c_RemoveJoints = "Remove Unnecessary Joints";
inline constexpr const char* c_MatchFilePose = "Take Pose from FBX";
inline constexpr const char* c_Rebind = "Re-bind";
inline constexpr const char* c_Scale = "Change Scale";
inline constexpr const char* c_ScaleRootHeight = "Scale Root Height";
inline constexpr const char* c_Weight = "Change Weight";
inline constexpr const char* c_State = "Change State";
inline constexpr const char* c_TargetFields = "Change Target";
inline constexpr const char* c_Pose = "Pose Segment";

} // namespace RetargetSetup::Steps
