/// \file
/// The classes in the project's MOF files, and what they build on.
#ifndef SCHEMA_PROJECTCLASSES_H
#define SCHEMA_PROJECTCLASSES_H

#include "schema/Classes.h"

namespace cimhost::schema {

/// Those of TAVRO_Glimmark.mof and TAVRO_ComputerSystem.mof.
inline std::vector<Class> projectClasses()
{
    std::vector<Class> classes = readMofFile(SCHEMA_DIRECTORY "/TAVRO_Glimmark.mof").classes;
    for (Class& declaration : readMofFile(SCHEMA_DIRECTORY "/TAVRO_ComputerSystem.mof").classes)
        classes.push_back(std::move(declaration));
    return classes;
}

/// The same with their superclasses.
inline Classes allClasses()
{
    std::vector<Class> classes = readMofFile(SUPERCLASSES).classes;
    for (Class& declaration : projectClasses())
        classes.push_back(std::move(declaration));
    return Classes(std::move(classes));
}

} // namespace cimhost::schema

#endif
