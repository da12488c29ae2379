# The floors of the house, from the ground: the wings of src/, and the libraries of each. A wing uses only wings below
# it, a library of its own wing only those that stand before it. The order is also the order of building.
set(RETARGET_WINGS base model kinematics toolbox formats motion hostdata scene plugin)
set(RETARGET_WING_base host math numerics UtilsFileSystem FileDigest FileSystemWatcher)
set(RETARGET_WING_model CoreOrlexTypes)
set(RETARGET_WING_kinematics ComputeSubjectFK ComputeSubjectSolve)
set(RETARGET_WING_toolbox CoreOrlexTypesUtils SetupProposal)
set(RETARGET_WING_formats UtilsRapidXml CoreOrlexQRTIO fbxsdk FBXIO TakeIO MotionIO SetupIO)
set(RETARGET_WING_motion TakeSolve)
set(RETARGET_WING_hostdata TesselDataStore TesselParameters TesselParametersGUI Flow2TypesUtils InMemoryHost)
set(RETARGET_WING_scene CoreGraphics OrlexGraphics Flow2Graphics)
set(RETARGET_WING_plugin RetargetSetupCore SetupReview RetargetSetupDocument OrlexQtQuick TesselPluginRetargetSetup)

# Above them apps/: the programs may use every library, the first of these folders, and nothing of each other.
set(RETARGET_PROGRAM_FOLDERS CommandLineText retarget studio)

# Which of them are built only where there is Qt.
set(RETARGET_QT_LIBRARY_FOLDERS hostdata/TesselParametersGUI scene/CoreGraphics scene/OrlexGraphics scene/Flow2Graphics
	plugin/RetargetSetupDocument plugin/OrlexQtQuick plugin/TesselPluginRetargetSetup)
set(RETARGET_QT_PROGRAM_FOLDERS studio)

foreach(wing IN LISTS RETARGET_WINGS)
	foreach(library IN LISTS RETARGET_WING_${wing})
		list(APPEND RETARGET_LIBRARY_FOLDERS ${wing}/${library})
	endforeach()
endforeach()
