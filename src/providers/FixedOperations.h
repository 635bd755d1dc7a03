/// \file
/// What an operation answers before anything went wrong, and the operations that answer the same whatever they are asked:
/// the library only reads, and cleaning up has nothing to do.
#ifndef TAVRO_GLIMMARK_FIXEDOPERATIONS_H
#define TAVRO_GLIMMARK_FIXEDOPERATIONS_H

#include <cmpift.h>

namespace Tavro::GlimmarkProvider {

inline CMPIStatus okStatus()
{
    return {CMPI_RC_OK, nullptr};
}

/// The answer to all that would change something.
inline CMPIStatus notSupportedStatus()
{
    return {CMPI_RC_ERR_NOT_SUPPORTED, nullptr};
}

} // namespace Tavro::GlimmarkProvider

// Each provider has these under names of its own, which stand in the library's symbol table: only a macro can name them.

/// Defines the fixed instance operations of a provider, PREFIX_Cleanup and so on.
// clang-format off
#define GLIMMARK_FIXED_INSTANCE_OPERATIONS(PREFIX)                                                                     \
    CMPIStatus PREFIX##_Cleanup(CMPIInstanceMI*, const CMPIContext*, CMPIBoolean)                                      \
    { return okStatus(); }                                                                                             \
    CMPIStatus PREFIX##_CreateInstance(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*,  \
                                       const CMPIInstance*)                                                            \
    { return notSupportedStatus(); }                                                                                   \
    CMPIStatus PREFIX##_ModifyInstance(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*,  \
                                       const CMPIInstance*, const char**)                                              \
    { return notSupportedStatus(); }                                                                                   \
    CMPIStatus PREFIX##_DeleteInstance(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*)  \
    { return notSupportedStatus(); }                                                                                   \
    CMPIStatus PREFIX##_ExecQuery(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*,       \
                                  const char*, const char*)                                                            \
    { return notSupportedStatus(); }

/// Defines PREFIX_AssociationCleanup.
#define GLIMMARK_FIXED_ASSOCIATION_OPERATIONS(PREFIX)                                                                  \
    CMPIStatus PREFIX##_AssociationCleanup(CMPIAssociationMI*, const CMPIContext*, CMPIBoolean)                        \
    { return okStatus(); }
// clang-format on

#endif
