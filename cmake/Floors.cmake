# The floors of the house, from the ground. A library may use only libraries of lower floors, or those that stand
# before it on its own floor when the floor is marked as ordered. The order is also the order of building.
set(RETARGET_FLOOR_0 platform/host model/math kinematics/numerics hostdata/UtilsFileSystem hostdata/FileSystemWatcher)
set(RETARGET_FLOOR_1 model/CoreOrlexTypes formats/UtilsRapidXml platform/fbxsdk)
set(RETARGET_FLOOR_2 kinematics/ComputeSubjectFK formats/FBXIO)
set(RETARGET_FLOOR_3 model/CoreOrlexTypesUtils)
set(RETARGET_FLOOR_4 formats/CoreOrlexQRTIO hostdata/TesselDataStore hostdata/TesselParameters
	hostdata/TesselParametersGUI hostdata/Flow2TypesUtils hostdata/InMemoryHost)
set(RETARGET_FLOOR_5 scene/CoreGraphics scene/OrlexGraphics scene/Flow2Graphics)
set(RETARGET_FLOOR_6 plugin/RetargetSetupDocument plugin/OrlexQtQuick plugin/TesselPluginRetargetSetup)
set(RETARGET_ORDERED_FLOORS 0 4 5 6)

foreach(floor RANGE 6)
	list(APPEND RETARGET_LIBRARY_FOLDERS ${RETARGET_FLOOR_${floor}})
endforeach()
