// Holds the CMPI headers in use, this project's or a broker's, to the interface as brokers have it
// on 64-bit Linux: every size, offset and constant. All checks run at compile time; building this
// file is the test.

#include <cmpidt.h>
#include <cmpift.h>

#include <cstddef>
#include <type_traits>

#define EXPECT_SLOT(type, member, offset) static_assert(offsetof(type, member) == (offset), #type "." #member)
// A table may be longer in newer headers, never shorter.
#define EXPECT_TABLE(type, bytes) static_assert(sizeof(type) >= (bytes), #type)
#define EXPECT_SIZE(type, bytes) static_assert(sizeof(type) == (bytes), #type)
#define EXPECT_VALUE(constant, value) static_assert((constant) == (value), #constant)
#define EXPECT_IS(type, same) static_assert(std::is_same_v<type, same>, #type)

// Scalar types.

EXPECT_IS(CMPIBoolean, unsigned char);
EXPECT_IS(CMPIChar16, unsigned short);
EXPECT_IS(CMPIUint8, unsigned char);
EXPECT_IS(CMPISint8, signed char);
EXPECT_IS(CMPIUint16, unsigned short);
EXPECT_IS(CMPISint16, short);
EXPECT_IS(CMPIUint32, unsigned int);
EXPECT_IS(CMPISint32, int);
EXPECT_IS(CMPIUint64, unsigned long long);
EXPECT_IS(CMPISint64, long long);
EXPECT_IS(CMPIReal32, float);
EXPECT_IS(CMPIReal64, double);
EXPECT_IS(CMPICount, unsigned int);
EXPECT_IS(CMPIType, unsigned short);
EXPECT_IS(CMPIValueState, unsigned short);
EXPECT_IS(CMPIFlags, unsigned int);
EXPECT_IS(std::remove_const_t<decltype(CMPIObjectPathFT::ftVersion)>, int);
EXPECT_IS(CMPIMsgFileHandle, void*);
EXPECT_IS(CMPIGcStat, void);
EXPECT_IS(CMPIAccessor, CMPIData(const char*, void*));

// Type constants.

EXPECT_VALUE(CMPI_null, 0);
EXPECT_VALUE(CMPI_boolean, 2);
EXPECT_VALUE(CMPI_char16, 3);
EXPECT_VALUE(CMPI_real32, 8);
EXPECT_VALUE(CMPI_real64, 12);
EXPECT_VALUE(CMPI_uint8, 128);
EXPECT_VALUE(CMPI_uint16, 144);
EXPECT_VALUE(CMPI_uint32, 160);
EXPECT_VALUE(CMPI_uint64, 176);
EXPECT_VALUE(CMPI_sint8, 192);
EXPECT_VALUE(CMPI_sint16, 208);
EXPECT_VALUE(CMPI_sint32, 224);
EXPECT_VALUE(CMPI_sint64, 240);
EXPECT_VALUE(CMPI_instance, 0x1000);
EXPECT_VALUE(CMPI_ref, 0x1100);
EXPECT_VALUE(CMPI_args, 0x1200);
EXPECT_VALUE(CMPI_class, 0x1300);
EXPECT_VALUE(CMPI_filter, 0x1400);
EXPECT_VALUE(CMPI_enumeration, 0x1500);
EXPECT_VALUE(CMPI_string, 0x1600);
EXPECT_VALUE(CMPI_chars, 0x1700);
EXPECT_VALUE(CMPI_dateTime, 0x1800);
EXPECT_VALUE(CMPI_ptr, 0x1900);
EXPECT_VALUE(CMPI_ARRAY, 0x2000);
EXPECT_VALUE(CMPI_uint16A, 0x2090);
EXPECT_VALUE(CMPI_SIMPLE, 2);
EXPECT_VALUE(CMPI_REAL, 8);
EXPECT_VALUE(CMPI_UINT, 128);
EXPECT_VALUE(CMPI_SINT, 192);
EXPECT_VALUE(CMPI_INTEGER, 192);
EXPECT_VALUE(CMPI_ENC, 0x1000);
EXPECT_VALUE(CMPI_goodValue, 0);
EXPECT_VALUE(CMPI_nullValue, 0x0100);
EXPECT_VALUE(CMPI_keyValue, 0x0200);
EXPECT_VALUE(CMPI_notFound, 0x0400);
EXPECT_VALUE(CMPI_badValue, 0x8000);

// Status codes, levels, severities, operators, capabilities.

EXPECT_VALUE(CMPI_RC_OK, 0);
EXPECT_VALUE(CMPI_RC_ERR_FAILED, 1);
EXPECT_VALUE(CMPI_RC_ERR_ACCESS_DENIED, 2);
EXPECT_VALUE(CMPI_RC_ERR_INVALID_NAMESPACE, 3);
EXPECT_VALUE(CMPI_RC_ERR_INVALID_PARAMETER, 4);
EXPECT_VALUE(CMPI_RC_ERR_INVALID_CLASS, 5);
EXPECT_VALUE(CMPI_RC_ERR_NOT_FOUND, 6);
EXPECT_VALUE(CMPI_RC_ERR_NOT_SUPPORTED, 7);
EXPECT_VALUE(CMPI_RC_ERR_CLASS_HAS_CHILDREN, 8);
EXPECT_VALUE(CMPI_RC_ERR_CLASS_HAS_INSTANCES, 9);
EXPECT_VALUE(CMPI_RC_ERR_INVALID_SUPERCLASS, 10);
EXPECT_VALUE(CMPI_RC_ERR_ALREADY_EXISTS, 11);
EXPECT_VALUE(CMPI_RC_ERR_NO_SUCH_PROPERTY, 12);
EXPECT_VALUE(CMPI_RC_ERR_TYPE_MISMATCH, 13);
EXPECT_VALUE(CMPI_RC_ERR_QUERY_LANGUAGE_NOT_SUPPORTED, 14);
EXPECT_VALUE(CMPI_RC_ERR_INVALID_QUERY, 15);
EXPECT_VALUE(CMPI_RC_ERR_METHOD_NOT_AVAILABLE, 16);
EXPECT_VALUE(CMPI_RC_ERR_METHOD_NOT_FOUND, 17);
EXPECT_VALUE(CMPI_RC_DO_NOT_UNLOAD, 50);
EXPECT_VALUE(CMPI_RC_NEVER_UNLOAD, 51);
EXPECT_VALUE(CMPI_RC_ERR_INVALID_HANDLE, 60);
EXPECT_VALUE(CMPI_RC_ERR_INVALID_DATA_TYPE, 61);
EXPECT_VALUE(CMPI_RC_ERROR_SYSTEM, 100);
EXPECT_VALUE(CMPI_RC_ERROR, 200);
EXPECT_VALUE(CMPI_LEV_INFO, 1);
EXPECT_VALUE(CMPI_LEV_WARNING, 2);
EXPECT_VALUE(CMPI_LEV_VERBOSE, 3);
EXPECT_VALUE(CMPI_SEV_ERROR, 1);
EXPECT_VALUE(CMPI_SEV_INFO, 2);
EXPECT_VALUE(CMPI_SEV_WARNING, 3);
EXPECT_VALUE(CMPI_DEV_DEBUG, 4);
EXPECT_VALUE(CMPI_PredOp_Equals, 1);
EXPECT_VALUE(CMPI_PredOp_NotEquals, 2);
EXPECT_VALUE(CMPI_PredOp_LessThan, 3);
EXPECT_VALUE(CMPI_PredOp_GreaterThanOrEquals, 4);
EXPECT_VALUE(CMPI_PredOp_GreaterThan, 5);
EXPECT_VALUE(CMPI_PredOp_LessThanOrEquals, 6);
EXPECT_VALUE(CMPI_PredOp_Isa, 7);
EXPECT_VALUE(CMPI_PredOp_NotIsa, 8);
EXPECT_VALUE(CMPI_PredOp_Like, 9);
EXPECT_VALUE(CMPI_PredOp_NotLike, 10);
EXPECT_VALUE(CMPI_PredOp_Not_Null, 11);
EXPECT_VALUE(CMPI_PredOp_Null, 12);
EXPECT_VALUE(CMPI_PredOp_And, 13);
EXPECT_VALUE(CMPI_PredOp_Or, 14);
EXPECT_VALUE(CMPI_MB_BasicRead, 0x1);
EXPECT_VALUE(CMPI_MB_BasicWrite, 0x3);
EXPECT_VALUE(CMPI_MB_InstanceManipulation, 0x7);
EXPECT_VALUE(CMPI_MB_AssociationTraversal, 0x9);
EXPECT_VALUE(CMPI_MB_QueryExecution, 0x11);
EXPECT_VALUE(CMPI_MB_QueryNormalization, 0x31);
EXPECT_VALUE(CMPI_MB_Indications, 0x81);
EXPECT_VALUE(CMPI_MB_BasicQualifierSupport, 0x47);
EXPECT_VALUE(CMPI_MB_OSEncapsulationSupport, 0x100);

// Names that not all headers have.

#ifdef CMPI_MB_Logging
EXPECT_VALUE(CMPI_MB_Logging, 0x10000);
EXPECT_VALUE(CMPI_MB_Tracing, 0x20000);
EXPECT_VALUE(CMPI_MB_PropertyFiltering, 0x40001);
EXPECT_IS(CMPIVersion, int);
EXPECT_IS(CMPIThreadFunc, void* (*)(void*));
EXPECT_IS(CMPIThreadOnceFunc, void (*)());
EXPECT_IS(CMPIThreadKeyCleanupFunc, void (*)(void*));
#endif

// Enumerations are four bytes wide.

EXPECT_SIZE(CMPIrc, 4);
EXPECT_SIZE(CMPILevel, 4);
EXPECT_SIZE(CMPISeverity, 4);
EXPECT_SIZE(CMPIPredOp, 4);
EXPECT_SIZE(CMPIErrorType, 4);
EXPECT_SIZE(CMPIErrorSeverity, 4);
EXPECT_SIZE(CMPIErrorProbableCause, 4);
EXPECT_SIZE(CMPIErrorSrcFormat, 4);

// Structures and function tables.

EXPECT_SIZE(CMPIValuePtr, 16);
EXPECT_SLOT(CMPIValuePtr, ptr, 0);
EXPECT_SLOT(CMPIValuePtr, length, 8);

EXPECT_SIZE(CMPIValue, 16);
EXPECT_SLOT(CMPIValue, boolean, 0);
EXPECT_SLOT(CMPIValue, char16, 0);
EXPECT_SLOT(CMPIValue, uint8, 0);
EXPECT_SLOT(CMPIValue, uint16, 0);
EXPECT_SLOT(CMPIValue, uint32, 0);
EXPECT_SLOT(CMPIValue, uint64, 0);
EXPECT_SLOT(CMPIValue, sint8, 0);
EXPECT_SLOT(CMPIValue, sint16, 0);
EXPECT_SLOT(CMPIValue, sint32, 0);
EXPECT_SLOT(CMPIValue, sint64, 0);
EXPECT_SLOT(CMPIValue, real32, 0);
EXPECT_SLOT(CMPIValue, real64, 0);
EXPECT_SLOT(CMPIValue, inst, 0);
EXPECT_SLOT(CMPIValue, ref, 0);
EXPECT_SLOT(CMPIValue, args, 0);
EXPECT_SLOT(CMPIValue, filter, 0);
EXPECT_SLOT(CMPIValue, Enum, 0);
EXPECT_SLOT(CMPIValue, array, 0);
EXPECT_SLOT(CMPIValue, string, 0);
EXPECT_SLOT(CMPIValue, chars, 0);
EXPECT_SLOT(CMPIValue, dateTime, 0);
EXPECT_SLOT(CMPIValue, dataPtr, 0);
EXPECT_SLOT(CMPIValue, Byte, 0);
EXPECT_SLOT(CMPIValue, Short, 0);
EXPECT_SLOT(CMPIValue, Int, 0);
EXPECT_SLOT(CMPIValue, Long, 0);
EXPECT_SLOT(CMPIValue, Float, 0);
EXPECT_SLOT(CMPIValue, Double, 0);

EXPECT_SIZE(CMPIData, 24);
EXPECT_SLOT(CMPIData, type, 0);
EXPECT_SLOT(CMPIData, state, 2);
EXPECT_SLOT(CMPIData, value, 8);

EXPECT_SIZE(CMPIStatus, 16);
EXPECT_SLOT(CMPIStatus, rc, 0);
EXPECT_SLOT(CMPIStatus, msg, 8);

EXPECT_SIZE(CMPIBroker, 40);
EXPECT_SLOT(CMPIBroker, hdl, 0);
EXPECT_SLOT(CMPIBroker, bft, 8);
EXPECT_SLOT(CMPIBroker, eft, 16);
EXPECT_SLOT(CMPIBroker, xft, 24);
EXPECT_SLOT(CMPIBroker, mft, 32);

EXPECT_TABLE(CMPIBrokerFT, 160);
EXPECT_SLOT(CMPIBrokerFT, brokerCapabilities, 0);
EXPECT_SLOT(CMPIBrokerFT, brokerVersion, 4);
EXPECT_SLOT(CMPIBrokerFT, brokerName, 8);
EXPECT_SLOT(CMPIBrokerFT, prepareAttachThread, 16);
EXPECT_SLOT(CMPIBrokerFT, attachThread, 24);
EXPECT_SLOT(CMPIBrokerFT, detachThread, 32);
EXPECT_SLOT(CMPIBrokerFT, deliverIndication, 40);
EXPECT_SLOT(CMPIBrokerFT, enumerateInstanceNames, 48);
EXPECT_SLOT(CMPIBrokerFT, getInstance, 56);
EXPECT_SLOT(CMPIBrokerFT, createInstance, 64);
EXPECT_SLOT(CMPIBrokerFT, modifyInstance, 72);
EXPECT_SLOT(CMPIBrokerFT, deleteInstance, 80);
EXPECT_SLOT(CMPIBrokerFT, execQuery, 88);
EXPECT_SLOT(CMPIBrokerFT, enumerateInstances, 96);
EXPECT_SLOT(CMPIBrokerFT, associators, 104);
EXPECT_SLOT(CMPIBrokerFT, associatorNames, 112);
EXPECT_SLOT(CMPIBrokerFT, references, 120);
EXPECT_SLOT(CMPIBrokerFT, referenceNames, 128);
EXPECT_SLOT(CMPIBrokerFT, invokeMethod, 136);
EXPECT_SLOT(CMPIBrokerFT, setProperty, 144);
EXPECT_SLOT(CMPIBrokerFT, getProperty, 152);

EXPECT_TABLE(CMPIBrokerEncFT, 168);
EXPECT_SLOT(CMPIBrokerEncFT, ftVersion, 0);
EXPECT_SLOT(CMPIBrokerEncFT, newInstance, 8);
EXPECT_SLOT(CMPIBrokerEncFT, newObjectPath, 16);
EXPECT_SLOT(CMPIBrokerEncFT, newArgs, 24);
EXPECT_SLOT(CMPIBrokerEncFT, newString, 32);
EXPECT_SLOT(CMPIBrokerEncFT, newArray, 40);
EXPECT_SLOT(CMPIBrokerEncFT, newDateTime, 48);
EXPECT_SLOT(CMPIBrokerEncFT, newDateTimeFromBinary, 56);
EXPECT_SLOT(CMPIBrokerEncFT, newDateTimeFromChars, 64);
EXPECT_SLOT(CMPIBrokerEncFT, newSelectExp, 72);
EXPECT_SLOT(CMPIBrokerEncFT, classPathIsA, 80);
EXPECT_SLOT(CMPIBrokerEncFT, toString, 88);
EXPECT_SLOT(CMPIBrokerEncFT, isOfType, 96);
EXPECT_SLOT(CMPIBrokerEncFT, getType, 104);
EXPECT_SLOT(CMPIBrokerEncFT, getMessage, 112);
EXPECT_SLOT(CMPIBrokerEncFT, logMessage, 120);
EXPECT_SLOT(CMPIBrokerEncFT, trace, 128);
EXPECT_SLOT(CMPIBrokerEncFT, newCMPIError, 136);
EXPECT_SLOT(CMPIBrokerEncFT, openMessageFile, 144);
EXPECT_SLOT(CMPIBrokerEncFT, closeMessageFile, 152);
EXPECT_SLOT(CMPIBrokerEncFT, getMessage2, 160);

EXPECT_TABLE(CMPIBrokerExtFT, 168);
EXPECT_SLOT(CMPIBrokerExtFT, ftVersion, 0);
EXPECT_SLOT(CMPIBrokerExtFT, resolveFileName, 8);
EXPECT_SLOT(CMPIBrokerExtFT, newThread, 16);
EXPECT_SLOT(CMPIBrokerExtFT, joinThread, 24);
EXPECT_SLOT(CMPIBrokerExtFT, exitThread, 32);
EXPECT_SLOT(CMPIBrokerExtFT, cancelThread, 40);
EXPECT_SLOT(CMPIBrokerExtFT, threadSleep, 48);
EXPECT_SLOT(CMPIBrokerExtFT, threadOnce, 56);
EXPECT_SLOT(CMPIBrokerExtFT, createThreadKey, 64);
EXPECT_SLOT(CMPIBrokerExtFT, destroyThreadKey, 72);
EXPECT_SLOT(CMPIBrokerExtFT, getThreadSpecific, 80);
EXPECT_SLOT(CMPIBrokerExtFT, setThreadSpecific, 88);
EXPECT_SLOT(CMPIBrokerExtFT, newMutex, 96);
EXPECT_SLOT(CMPIBrokerExtFT, destroyMutex, 104);
EXPECT_SLOT(CMPIBrokerExtFT, lockMutex, 112);
EXPECT_SLOT(CMPIBrokerExtFT, unlockMutex, 120);
EXPECT_SLOT(CMPIBrokerExtFT, newCondition, 128);
EXPECT_SLOT(CMPIBrokerExtFT, destroyCondition, 136);
EXPECT_SLOT(CMPIBrokerExtFT, condWait, 144);
EXPECT_SLOT(CMPIBrokerExtFT, timedCondWait, 152);
EXPECT_SLOT(CMPIBrokerExtFT, signalCondition, 160);

EXPECT_TABLE(CMPIBrokerMemFT, 120);
EXPECT_SLOT(CMPIBrokerMemFT, ftVersion, 0);
EXPECT_SLOT(CMPIBrokerMemFT, mark, 8);
EXPECT_SLOT(CMPIBrokerMemFT, release, 16);
EXPECT_SLOT(CMPIBrokerMemFT, cmpiMalloc, 24);
EXPECT_SLOT(CMPIBrokerMemFT, cmpiCalloc, 32);
EXPECT_SLOT(CMPIBrokerMemFT, cmpiRealloc, 40);
EXPECT_SLOT(CMPIBrokerMemFT, cmpiStrDup, 48);
EXPECT_SLOT(CMPIBrokerMemFT, cmpiFree, 56);
EXPECT_SLOT(CMPIBrokerMemFT, freeInstance, 64);
EXPECT_SLOT(CMPIBrokerMemFT, freeObjectPath, 72);
EXPECT_SLOT(CMPIBrokerMemFT, freeArgs, 80);
EXPECT_SLOT(CMPIBrokerMemFT, freeString, 88);
EXPECT_SLOT(CMPIBrokerMemFT, freeArray, 96);
EXPECT_SLOT(CMPIBrokerMemFT, freeDateTime, 104);
EXPECT_SLOT(CMPIBrokerMemFT, freeSelectExp, 112);

EXPECT_SIZE(CMPIContext, 16);
EXPECT_SLOT(CMPIContext, hdl, 0);
EXPECT_SLOT(CMPIContext, ft, 8);

EXPECT_TABLE(CMPIContextFT, 56);
EXPECT_SLOT(CMPIContextFT, ftVersion, 0);
EXPECT_SLOT(CMPIContextFT, release, 8);
EXPECT_SLOT(CMPIContextFT, clone, 16);
EXPECT_SLOT(CMPIContextFT, getEntry, 24);
EXPECT_SLOT(CMPIContextFT, getEntryAt, 32);
EXPECT_SLOT(CMPIContextFT, getEntryCount, 40);
EXPECT_SLOT(CMPIContextFT, addEntry, 48);

EXPECT_SIZE(CMPIResult, 16);
EXPECT_SLOT(CMPIResult, hdl, 0);
EXPECT_SLOT(CMPIResult, ft, 8);

EXPECT_TABLE(CMPIResultFT, 64);
EXPECT_SLOT(CMPIResultFT, ftVersion, 0);
EXPECT_SLOT(CMPIResultFT, release, 8);
EXPECT_SLOT(CMPIResultFT, clone, 16);
EXPECT_SLOT(CMPIResultFT, returnData, 24);
EXPECT_SLOT(CMPIResultFT, returnInstance, 32);
EXPECT_SLOT(CMPIResultFT, returnObjectPath, 40);
EXPECT_SLOT(CMPIResultFT, returnDone, 48);
EXPECT_SLOT(CMPIResultFT, returnError, 56);

EXPECT_SIZE(CMPIString, 16);
EXPECT_SLOT(CMPIString, hdl, 0);
EXPECT_SLOT(CMPIString, ft, 8);

EXPECT_TABLE(CMPIStringFT, 32);
EXPECT_SLOT(CMPIStringFT, ftVersion, 0);
EXPECT_SLOT(CMPIStringFT, release, 8);
EXPECT_SLOT(CMPIStringFT, clone, 16);
EXPECT_SLOT(CMPIStringFT, getCharPtr, 24);

EXPECT_SIZE(CMPIArray, 16);
EXPECT_SLOT(CMPIArray, hdl, 0);
EXPECT_SLOT(CMPIArray, ft, 8);

EXPECT_TABLE(CMPIArrayFT, 56);
EXPECT_SLOT(CMPIArrayFT, ftVersion, 0);
EXPECT_SLOT(CMPIArrayFT, release, 8);
EXPECT_SLOT(CMPIArrayFT, clone, 16);
EXPECT_SLOT(CMPIArrayFT, getSize, 24);
EXPECT_SLOT(CMPIArrayFT, getSimpleType, 32);
EXPECT_SLOT(CMPIArrayFT, getElementAt, 40);
EXPECT_SLOT(CMPIArrayFT, setElementAt, 48);

EXPECT_SIZE(CMPIEnumeration, 16);
EXPECT_SLOT(CMPIEnumeration, hdl, 0);
EXPECT_SLOT(CMPIEnumeration, ft, 8);

EXPECT_TABLE(CMPIEnumerationFT, 48);
EXPECT_SLOT(CMPIEnumerationFT, ftVersion, 0);
EXPECT_SLOT(CMPIEnumerationFT, release, 8);
EXPECT_SLOT(CMPIEnumerationFT, clone, 16);
EXPECT_SLOT(CMPIEnumerationFT, getNext, 24);
EXPECT_SLOT(CMPIEnumerationFT, hasNext, 32);
EXPECT_SLOT(CMPIEnumerationFT, toArray, 40);

EXPECT_SIZE(CMPIInstance, 16);
EXPECT_SLOT(CMPIInstance, hdl, 0);
EXPECT_SLOT(CMPIInstance, ft, 8);

EXPECT_TABLE(CMPIInstanceFT, 88);
EXPECT_SLOT(CMPIInstanceFT, ftVersion, 0);
EXPECT_SLOT(CMPIInstanceFT, release, 8);
EXPECT_SLOT(CMPIInstanceFT, clone, 16);
EXPECT_SLOT(CMPIInstanceFT, getProperty, 24);
EXPECT_SLOT(CMPIInstanceFT, getPropertyAt, 32);
EXPECT_SLOT(CMPIInstanceFT, getPropertyCount, 40);
EXPECT_SLOT(CMPIInstanceFT, setProperty, 48);
EXPECT_SLOT(CMPIInstanceFT, getObjectPath, 56);
EXPECT_SLOT(CMPIInstanceFT, setPropertyFilter, 64);
EXPECT_SLOT(CMPIInstanceFT, setObjectPath, 72);
EXPECT_SLOT(CMPIInstanceFT, setPropertyWithOrigin, 80);

EXPECT_SIZE(CMPIObjectPath, 16);
EXPECT_SLOT(CMPIObjectPath, hdl, 0);
EXPECT_SLOT(CMPIObjectPath, ft, 8);

EXPECT_TABLE(CMPIObjectPathFT, 160);
EXPECT_SLOT(CMPIObjectPathFT, ftVersion, 0);
EXPECT_SLOT(CMPIObjectPathFT, release, 8);
EXPECT_SLOT(CMPIObjectPathFT, clone, 16);
EXPECT_SLOT(CMPIObjectPathFT, setNameSpace, 24);
EXPECT_SLOT(CMPIObjectPathFT, getNameSpace, 32);
EXPECT_SLOT(CMPIObjectPathFT, setHostname, 40);
EXPECT_SLOT(CMPIObjectPathFT, getHostname, 48);
EXPECT_SLOT(CMPIObjectPathFT, setClassName, 56);
EXPECT_SLOT(CMPIObjectPathFT, getClassName, 64);
EXPECT_SLOT(CMPIObjectPathFT, addKey, 72);
EXPECT_SLOT(CMPIObjectPathFT, getKey, 80);
EXPECT_SLOT(CMPIObjectPathFT, getKeyAt, 88);
EXPECT_SLOT(CMPIObjectPathFT, getKeyCount, 96);
EXPECT_SLOT(CMPIObjectPathFT, setNameSpaceFromObjectPath, 104);
EXPECT_SLOT(CMPIObjectPathFT, setHostAndNameSpaceFromObjectPath, 112);
EXPECT_SLOT(CMPIObjectPathFT, getClassQualifier, 120);
EXPECT_SLOT(CMPIObjectPathFT, getPropertyQualifier, 128);
EXPECT_SLOT(CMPIObjectPathFT, getMethodQualifier, 136);
EXPECT_SLOT(CMPIObjectPathFT, getParameterQualifier, 144);
EXPECT_SLOT(CMPIObjectPathFT, toString, 152);

EXPECT_SIZE(CMPIArgs, 16);
EXPECT_SLOT(CMPIArgs, hdl, 0);
EXPECT_SLOT(CMPIArgs, ft, 8);

EXPECT_TABLE(CMPIArgsFT, 56);
EXPECT_SLOT(CMPIArgsFT, ftVersion, 0);
EXPECT_SLOT(CMPIArgsFT, release, 8);
EXPECT_SLOT(CMPIArgsFT, clone, 16);
EXPECT_SLOT(CMPIArgsFT, addArg, 24);
EXPECT_SLOT(CMPIArgsFT, getArg, 32);
EXPECT_SLOT(CMPIArgsFT, getArgAt, 40);
EXPECT_SLOT(CMPIArgsFT, getArgCount, 48);

EXPECT_SIZE(CMPIDateTime, 16);
EXPECT_SLOT(CMPIDateTime, hdl, 0);
EXPECT_SLOT(CMPIDateTime, ft, 8);

EXPECT_TABLE(CMPIDateTimeFT, 48);
EXPECT_SLOT(CMPIDateTimeFT, ftVersion, 0);
EXPECT_SLOT(CMPIDateTimeFT, release, 8);
EXPECT_SLOT(CMPIDateTimeFT, clone, 16);
EXPECT_SLOT(CMPIDateTimeFT, getBinaryFormat, 24);
EXPECT_SLOT(CMPIDateTimeFT, getStringFormat, 32);
EXPECT_SLOT(CMPIDateTimeFT, isInterval, 40);

EXPECT_SIZE(CMPISelectExp, 16);
EXPECT_SLOT(CMPISelectExp, hdl, 0);
EXPECT_SLOT(CMPISelectExp, ft, 8);

EXPECT_TABLE(CMPISelectExpFT, 64);
EXPECT_SLOT(CMPISelectExpFT, ftVersion, 0);
EXPECT_SLOT(CMPISelectExpFT, release, 8);
EXPECT_SLOT(CMPISelectExpFT, clone, 16);
EXPECT_SLOT(CMPISelectExpFT, evaluate, 24);
EXPECT_SLOT(CMPISelectExpFT, getString, 32);
EXPECT_SLOT(CMPISelectExpFT, getDOC, 40);
EXPECT_SLOT(CMPISelectExpFT, getCOD, 48);
EXPECT_SLOT(CMPISelectExpFT, evaluateUsingAccessor, 56);

EXPECT_SIZE(CMPISelectCond, 16);
EXPECT_SLOT(CMPISelectCond, hdl, 0);
EXPECT_SLOT(CMPISelectCond, ft, 8);

EXPECT_TABLE(CMPISelectCondFT, 40);
EXPECT_SLOT(CMPISelectCondFT, ftVersion, 0);
EXPECT_SLOT(CMPISelectCondFT, release, 8);
EXPECT_SLOT(CMPISelectCondFT, clone, 16);
EXPECT_SLOT(CMPISelectCondFT, getCountAndType, 24);
EXPECT_SLOT(CMPISelectCondFT, getSubCondAt, 32);

EXPECT_SIZE(CMPISubCond, 16);
EXPECT_SLOT(CMPISubCond, hdl, 0);
EXPECT_SLOT(CMPISubCond, ft, 8);

EXPECT_TABLE(CMPISubCondFT, 48);
EXPECT_SLOT(CMPISubCondFT, ftVersion, 0);
EXPECT_SLOT(CMPISubCondFT, release, 8);
EXPECT_SLOT(CMPISubCondFT, clone, 16);
EXPECT_SLOT(CMPISubCondFT, getCount, 24);
EXPECT_SLOT(CMPISubCondFT, getPredicateAt, 32);
EXPECT_SLOT(CMPISubCondFT, getPredicate, 40);

EXPECT_SIZE(CMPIPredicate, 16);
EXPECT_SLOT(CMPIPredicate, hdl, 0);
EXPECT_SLOT(CMPIPredicate, ft, 8);

EXPECT_TABLE(CMPIPredicateFT, 40);
EXPECT_SLOT(CMPIPredicateFT, ftVersion, 0);
EXPECT_SLOT(CMPIPredicateFT, release, 8);
EXPECT_SLOT(CMPIPredicateFT, clone, 16);
EXPECT_SLOT(CMPIPredicateFT, getData, 24);
EXPECT_SLOT(CMPIPredicateFT, evaluateUsingAccessor, 32);

EXPECT_SIZE(CMPIError, 16);
EXPECT_SLOT(CMPIError, hdl, 0);
EXPECT_SLOT(CMPIError, ft, 8);

EXPECT_TABLE(CMPIErrorFT, 216);
EXPECT_SLOT(CMPIErrorFT, ftVersion, 0);
EXPECT_SLOT(CMPIErrorFT, release, 8);
EXPECT_SLOT(CMPIErrorFT, clone, 16);
EXPECT_SLOT(CMPIErrorFT, getErrorType, 24);
EXPECT_SLOT(CMPIErrorFT, getOtherErrorType, 32);
EXPECT_SLOT(CMPIErrorFT, getOwningEntity, 40);
EXPECT_SLOT(CMPIErrorFT, getMessageID, 48);
EXPECT_SLOT(CMPIErrorFT, getMessage, 56);
EXPECT_SLOT(CMPIErrorFT, getPerceivedSeverity, 64);
EXPECT_SLOT(CMPIErrorFT, getProbableCause, 72);
EXPECT_SLOT(CMPIErrorFT, getProbableCauseDescription, 80);
EXPECT_SLOT(CMPIErrorFT, getRecommendedActions, 88);
EXPECT_SLOT(CMPIErrorFT, getErrorSource, 96);
EXPECT_SLOT(CMPIErrorFT, getErrorSourceFormat, 104);
EXPECT_SLOT(CMPIErrorFT, getOtherErrorSourceFormat, 112);
EXPECT_SLOT(CMPIErrorFT, getCIMStatusCode, 120);
EXPECT_SLOT(CMPIErrorFT, getCIMStatusCodeDescription, 128);
EXPECT_SLOT(CMPIErrorFT, getMessageArguments, 136);
EXPECT_SLOT(CMPIErrorFT, setErrorType, 144);
EXPECT_SLOT(CMPIErrorFT, setOtherErrorType, 152);
EXPECT_SLOT(CMPIErrorFT, setProbableCauseDescription, 160);
EXPECT_SLOT(CMPIErrorFT, setRecommendedActions, 168);
EXPECT_SLOT(CMPIErrorFT, setErrorSource, 176);
EXPECT_SLOT(CMPIErrorFT, setErrorSourceFormat, 184);
EXPECT_SLOT(CMPIErrorFT, setOtherErrorSourceFormat, 192);
EXPECT_SLOT(CMPIErrorFT, setCIMStatusCodeDescription, 200);
EXPECT_SLOT(CMPIErrorFT, setMessageArguments, 208);

EXPECT_SIZE(CMPIInstanceMI, 16);
EXPECT_SLOT(CMPIInstanceMI, hdl, 0);
EXPECT_SLOT(CMPIInstanceMI, ft, 8);

EXPECT_TABLE(CMPIInstanceMIFT, 80);
EXPECT_SLOT(CMPIInstanceMIFT, ftVersion, 0);
EXPECT_SLOT(CMPIInstanceMIFT, miVersion, 4);
EXPECT_SLOT(CMPIInstanceMIFT, miName, 8);
EXPECT_SLOT(CMPIInstanceMIFT, cleanup, 16);
EXPECT_SLOT(CMPIInstanceMIFT, enumerateInstanceNames, 24);
EXPECT_SLOT(CMPIInstanceMIFT, enumerateInstances, 32);
EXPECT_SLOT(CMPIInstanceMIFT, getInstance, 40);
EXPECT_SLOT(CMPIInstanceMIFT, createInstance, 48);
EXPECT_SLOT(CMPIInstanceMIFT, modifyInstance, 56);
EXPECT_SLOT(CMPIInstanceMIFT, deleteInstance, 64);
EXPECT_SLOT(CMPIInstanceMIFT, execQuery, 72);

EXPECT_SIZE(CMPIAssociationMI, 16);
EXPECT_SLOT(CMPIAssociationMI, hdl, 0);
EXPECT_SLOT(CMPIAssociationMI, ft, 8);

EXPECT_TABLE(CMPIAssociationMIFT, 56);
EXPECT_SLOT(CMPIAssociationMIFT, ftVersion, 0);
EXPECT_SLOT(CMPIAssociationMIFT, miVersion, 4);
EXPECT_SLOT(CMPIAssociationMIFT, miName, 8);
EXPECT_SLOT(CMPIAssociationMIFT, cleanup, 16);
EXPECT_SLOT(CMPIAssociationMIFT, associators, 24);
EXPECT_SLOT(CMPIAssociationMIFT, associatorNames, 32);
EXPECT_SLOT(CMPIAssociationMIFT, references, 40);
EXPECT_SLOT(CMPIAssociationMIFT, referenceNames, 48);

// Mangled names carry the tags: a library built with other headers must agree on them.
EXPECT_IS(CMPIBroker, struct _CMPIBroker);
EXPECT_IS(CMPIContext, struct _CMPIContext);
EXPECT_IS(CMPIResult, struct _CMPIResult);
EXPECT_IS(CMPIString, struct _CMPIString);
EXPECT_IS(CMPIArray, struct _CMPIArray);
EXPECT_IS(CMPIEnumeration, struct _CMPIEnumeration);
EXPECT_IS(CMPIInstance, struct _CMPIInstance);
EXPECT_IS(CMPIObjectPath, struct _CMPIObjectPath);
EXPECT_IS(CMPIArgs, struct _CMPIArgs);
EXPECT_IS(CMPIDateTime, struct _CMPIDateTime);
EXPECT_IS(CMPISelectExp, struct _CMPISelectExp);
EXPECT_IS(CMPISelectCond, struct _CMPISelectCond);
EXPECT_IS(CMPISubCond, struct _CMPISubCond);
EXPECT_IS(CMPIPredicate, struct _CMPIPredicate);
EXPECT_IS(CMPIError, struct _CMPIError);
EXPECT_IS(CMPIInstanceMI, struct _CMPIInstanceMI);
EXPECT_IS(CMPIAssociationMI, struct _CMPIAssociationMI);
EXPECT_IS(CMPIValuePtr, struct _CMPIValuePtr);
EXPECT_IS(CMPIData, struct _CMPIData);
EXPECT_IS(CMPIStatus, struct _CMPIStatus);
EXPECT_IS(CMPIValue, union _CMPIValue);
EXPECT_IS(CMPIrc, enum _CMPIrc);
EXPECT_IS(CMPILevel, enum _CMPILevel);
EXPECT_IS(CMPISeverity, enum _CMPISeverity);
