#pragma once

#include "include/Trace.h"

#include <cmpidt.h>
#include <cmpift.h>
#include <cmpimacs.h>

#include <atomic>
#include <string>
#include <vector>

/// The provider as the object manager sees it: the functions of its three tables.
///
/// Instance and association operations log an exception and return the status as it stood, which is CMPI_RC_OK
/// unless the class is not served; method invocation passes the exception's text on. Nothing is kept between calls.
namespace VK::BaseServerProvider {

/// The object manager's broker, stored by every factory function and never cleared. Atomic because an object manager
/// may ask for one interface while another is at work.
extern std::atomic<const CMPIBroker*> broker;

extern const TraceSource frameSource;

CMPIStatus BaseServer_Cleanup(CMPIInstanceMI*, const CMPIContext*, CMPIBoolean terminating);
CMPIStatus BaseServer_EnumInstanceNames(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*,
                                        const CMPIObjectPath* ref);
CMPIStatus BaseServer_EnumInstances(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath* ref,
                                    const char** properties);
CMPIStatus BaseServer_GetInstance(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath* ref,
                                  const char** properties);
CMPIStatus BaseServer_CreateInstance(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*,
                                     const CMPIInstance*);
CMPIStatus BaseServer_ModifyInstance(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath* ref,
                                     const CMPIInstance* instance, const char** properties);
CMPIStatus BaseServer_DeleteInstance(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*);
CMPIStatus BaseServer_ExecQuery(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*,
                                const char* query, const char* language);

CMPIStatus BaseServer_AssociationCleanup(CMPIAssociationMI*, const CMPIContext*, CMPIBoolean terminating);
CMPIStatus BaseServer_Associators(CMPIAssociationMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath* op,
                                  const char* assocClass, const char* resultClass, const char* role,
                                  const char* resultRole, const char** properties);
CMPIStatus BaseServer_AssociatorNames(CMPIAssociationMI*, const CMPIContext*, const CMPIResult*,
                                      const CMPIObjectPath* op, const char* assocClass, const char* resultClass,
                                      const char* role, const char* resultRole);
CMPIStatus BaseServer_References(CMPIAssociationMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*,
                                 const char* resultClass, const char* role, const char** properties);
CMPIStatus BaseServer_ReferenceNames(CMPIAssociationMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*,
                                     const char* resultClass, const char* role);

CMPIStatus BaseServer_MethodCleanup(CMPIMethodMI*, const CMPIContext*, CMPIBoolean terminating);
CMPIStatus BaseServer_InvokeMethod(CMPIMethodMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath* ref,
                                   const char* methodName, const CMPIArgs* in, CMPIArgs* out);

/// The class identifiers that an association class stands for: its own, or those of the associations that the schema
/// relates it to, in the order 33, 24, 162. A null or empty name stands for all three: object managers that ask every
/// association provider of a namespace give none, and an error would fail the others' answers. False when there are
/// none.
bool getClassId(const char* className, const char* nameSpace, std::vector<unsigned short>& ids);

} // namespace VK::BaseServerProvider
