/// \file
/// In the place of CMPI for the model, which knows none: the one name that Tavro/Common.h needs, as the CMPI
/// headers declare it.
#ifndef GLIMMARK_WITHOUT_CMPI_H
#define GLIMMARK_WITHOUT_CMPI_H

using CMPIObjectPath = struct _CMPIObjectPath;

#endif
