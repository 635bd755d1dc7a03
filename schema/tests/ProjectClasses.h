/// \file
/// The classes in the project's MOF files, and what they build on.
#ifndef SCHEMA_PROJECTCLASSES_H
#define SCHEMA_PROJECTCLASSES_H

#include "Classes.h"

namespace schema {

/// Those of TAVRO_Glimmark.mof and TAVRO_ComputerSystem.mof.
inline std::vector<Class> projectClasses()
{
    std::vector<Class> classes = readMofFile(SCHEMA_DIRECTORY "/TAVRO_Glimmark.mof");
    for (Class& declaration : readMofFile(SCHEMA_DIRECTORY "/TAVRO_ComputerSystem.mof"))
        classes.push_back(std::move(declaration));
    return classes;
}

/// The same with their superclasses.
inline Classes allClasses()
{
    std::vector<Class> classes = readMofFile(SCHEMA_DIRECTORY "/tests/dmtf-superclasses.mof");
    for (Class& declaration : projectClasses())
        classes.push_back(std::move(declaration));
    return Classes(std::move(classes));
}

} // namespace schema

#endif
