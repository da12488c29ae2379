#include "TesselDataStore/StoredValueOfFields.h"

RETARGET_STORED_VALUE(CoreOrlexTypes::VSubject)
RETARGET_STORED_VALUE(CoreOrlexTypes::VSubjectApplicationData)
RETARGET_STORED_VALUE(CoreOrlexTypes::VSubjectParametrised)
RETARGET_STORED_VALUE(CoreOrlexTypes::VSubjectRecord)
