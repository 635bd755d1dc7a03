# The Debian or RPM packages, made by CPack from the installation components.
#
# One package for each support library, so that a maker replaces one and keeps the others. On Debian the maker's
# package says Provides, Conflicts and Replaces with the name of the package here; with RPM the soname says it all.

set(GLIMMARK_PACKAGES
    DEB
    CACHE STRING "Packages that CPack makes: DEB or RPM")

# glimmark_package(COMPONENT NAME SECTION SUMMARY DESCRIPTION)
#
# SECTION is Debian's.
function(glimmark_package component name section summary description)
    string(TOUPPER ${component} key)
    # A phrase on Debian, a headline elsewhere.
    string(SUBSTRING ${summary} 0 1 initial)
    string(SUBSTRING ${summary} 1 -1 rest)
    string(TOUPPER ${initial} initial)
    foreach(
        setting
        "DEBIAN_${key}_PACKAGE_NAME|${name}"
        "DEBIAN_${key}_PACKAGE_SECTION|${section}"
        "DEBIAN_${key}_DESCRIPTION|${summary}\n${description}"
        "RPM_${key}_PACKAGE_NAME|${name}"
        "RPM_${key}_PACKAGE_SUMMARY|${initial}${rest}"
        "RPM_${key}_PACKAGE_DESCRIPTION|${description}")
        string(REGEX MATCH "^[^|]*" variable "${setting}")
        string(REGEX REPLACE "^[^|]*[|]" "" value "${setting}")
        set(CPACK_${variable} "${value}" PARENT_SCOPE)
    endforeach()
    set(CPACK_COMPONENTS_ALL ${CPACK_COMPONENTS_ALL} ${component} PARENT_SCOPE)

    install(
        FILES ${CMAKE_CURRENT_SOURCE_DIR}/copyright
        DESTINATION ${CMAKE_INSTALL_DATAROOTDIR}/doc/${name}
        COMPONENT ${component}
        EXCLUDE_FROM_ALL)
    if(GLIMMARK_PACKAGES STREQUAL "DEB")
        install(
            FILES ${CMAKE_CURRENT_BINARY_DIR}/changelog.gz
            DESTINATION ${CMAKE_INSTALL_DATAROOTDIR}/doc/${name}
            COMPONENT ${component}
            EXCLUDE_FROM_ALL)
    endif()
endfunction()

configure_file(changelog.in changelog @ONLY)
glimmark_compress(${CMAKE_CURRENT_BINARY_DIR}/changelog ${CMAKE_CURRENT_BINARY_DIR}/changelog.gz)
list(APPEND compressed ${CMAKE_CURRENT_BINARY_DIR}/changelog.gz)

set(CPACK_COMPONENTS_ALL)
glimmark_package(
    provider glimmark-provider admin "CIM provider of a server's diagnostic indicators"
    "A management broker loads this library through the CMPI interface and asks
it about the diagnostic indicators of the machine it runs on. The classes and
their registration with a broker come along; glimmark-register registers them.")
glimmark_package(
    computer-system glimmark-computer-system admin "CIM provider of the computer system, stand-in"
    "Serves the class TAVRO_ComputerSystem to a management broker, for machines
where no provider of the server's maker does.")
glimmark_package(
    tavro-instrumentation libtavro-instrumentation1 libs "hardware inventory of the Glimmark provider, stand-in"
    "Stands in for the support library of a server's maker: reads the hardware
inventory from sysfs or a file. Sample inventories come along.")
glimmark_package(
    tavro-common libtavro-common1 libs "common functions of the Glimmark provider, stand-in"
    "Stands in for the support library of a server's maker: host name and comparison
of object paths.")
glimmark_package(
    tavro-locale libtavro-locale1 libs "texts of the Glimmark provider, stand-in"
    "Stands in for the support library of a server's maker: texts in the language
of the process.")
glimmark_package(
    mvlog libmvlog1 libs "logging of the Glimmark provider, stand-in"
    "Stands in for the support library of a server's maker: log and trace lines to
standard error or a file.")
if(GLIMMARK_PACKAGES STREQUAL "DEB")
    set(development_package libtavro-dev)
else()
    set(development_package libtavro-devel)
endif()
glimmark_package(
    support-development ${development_package} libdevel "support libraries of the Glimmark provider, development files"
    "Headers, CMake package and pkg-config file to build support libraries that take
the place of the stand-ins, and programs that use them.")
glimmark_package(
    cimhost cimhost admin "asks CIM providers without a CIM server"
    "A CMPI broker in one process and its command line, for development and tests:
loads CIM providers and asks them what a CIM client asks.")

set(CPACK_PACKAGE_NAME glimmark-provider)
# Each package has its own.
set(CPACK_PACKAGE_DESCRIPTION_SUMMARY "")
set(CPACK_PACKAGE_VENDOR Tavro)
set(CPACK_PACKAGE_CONTACT "Tavro <glimmark@tavro.example>")
set(CPACK_PACKAGE_VERSION ${PROJECT_VERSION})
set(CPACK_PACKAGING_INSTALL_PREFIX ${CMAKE_INSTALL_PREFIX})
set(CPACK_GENERATOR ${GLIMMARK_PACKAGES})
set(CPACK_STRIP_FILES ON)
set(CPACK_VERBATIM_VARIABLES ON)

set(CPACK_PRE_BUILD_SCRIPTS ${CMAKE_CURRENT_SOURCE_DIR}/dates.cmake)
set(CPACK_DEB_COMPONENT_INSTALL ON)
set(CPACK_DEBIAN_FILE_NAME DEB-DEFAULT)
set(CPACK_DEBIAN_COMPRESSION_TYPE xz)
# Whatever those of the sources are, which an archive that root unpacks has from git.
set(CPACK_DEBIAN_PACKAGE_CONTROL_STRICT_PERMISSION ON)
set(CPACK_DEBIAN_PACKAGE_SHLIBDEPS ON)
# The packages of the support libraries are named below: a dependency on a soname of theirs is met by another's too.
set(CPACK_DEBIAN_PACKAGE_SHLIBDEPS_PRIVATE_DIRS ${CMAKE_LIBRARY_OUTPUT_DIRECTORY})
# Those of another architecture lie apart.
if(CMAKE_CROSSCOMPILING)
    list(APPEND CPACK_DEBIAN_PACKAGE_SHLIBDEPS_PRIVATE_DIRS ${CMAKE_SYSROOT}/lib/${CMAKE_LIBRARY_ARCHITECTURE}
         ${CMAKE_SYSROOT}/usr/lib/${CMAKE_LIBRARY_ARCHITECTURE})
endif()
set(support_packages "libtavro-instrumentation1, libtavro-common1, libtavro-locale1, libmvlog1")
# glimmark-register is a Python program.
set(CPACK_DEBIAN_PROVIDER_PACKAGE_DEPENDS "${support_packages}, python3:any")
set(CPACK_DEBIAN_PROVIDER_PACKAGE_SUGGESTS cimhost)
set(CPACK_DEBIAN_COMPUTER-SYSTEM_PACKAGE_DEPENDS "libtavro-common1, libtavro-locale1")
set(CPACK_DEBIAN_TAVRO-INSTRUMENTATION_PACKAGE_DEPENDS libmvlog1)
set(CPACK_DEBIAN_TAVRO-LOCALE_PACKAGE_DEPENDS libmvlog1)
set(CPACK_DEBIAN_SUPPORT-DEVELOPMENT_PACKAGE_DEPENDS "${support_packages}")
set(CPACK_DEBIAN_CIMHOST_PACKAGE_RECOMMENDS glimmark-provider)
foreach(library tavro-instrumentation tavro-common tavro-locale mvlog)
    # Without a version: a package that stands for this one has none.
    file(WRITE ${CMAKE_CURRENT_BINARY_DIR}/${library}/shlibs "lib${library} 1 lib${library}1\n")
    string(TOUPPER ${library} component)
    # The trigger runs ldconfig. CPack brings scripts that run it too, unless there are others: these do not exist, and
    # so none comes along.
    set(CPACK_DEBIAN_${component}_PACKAGE_CONTROL_EXTRA
        ${CMAKE_CURRENT_SOURCE_DIR}/triggers ${CMAKE_CURRENT_BINARY_DIR}/${library}/shlibs
        ${CMAKE_CURRENT_BINARY_DIR}/none/postinst ${CMAKE_CURRENT_BINARY_DIR}/none/postrm)
    set(CPACK_RPM_${component}_POST_INSTALL_SCRIPT_FILE ${CMAKE_CURRENT_SOURCE_DIR}/ldconfig)
    set(CPACK_RPM_${component}_POST_UNINSTALL_SCRIPT_FILE ${CMAKE_CURRENT_SOURCE_DIR}/ldconfig)
endforeach()

set(CPACK_RPM_COMPONENT_INSTALL ON)
set(CPACK_RPM_FILE_NAME RPM-DEFAULT)
# What glimmark-register runs, which on Debian is there always. Its interpreter rpm finds for itself.
set(CPACK_RPM_PROVIDER_PACKAGE_REQUIRES coreutils)
set(CPACK_RPM_SUPPORT-DEVELOPMENT_PACKAGE_REQUIRES
    "libtavro-instrumentation.so.1()(64bit), libtavro-common.so.1()(64bit), libtavro-locale.so.1()(64bit), libmvlog.so.1()(64bit)"
)
# Folders of the distribution's package filesystem.
set(CPACK_RPM_EXCLUDE_FROM_AUTO_FILELIST_ADDITION
    /usr/libexec
    /usr/sbin
    /usr/share/locale
    /usr/share/man
    /usr/share/man/man1
    /usr/share/man/man8)
# A file of one language is installed where that language is.
get_property(languages GLOBAL PROPERTY GLIMMARK_LANGUAGES)
foreach(language IN LISTS languages)
    list(APPEND CPACK_RPM_TAVRO-LOCALE_USER_FILELIST
         "%lang(${language}) ${CMAKE_INSTALL_FULL_LOCALEDIR}/${language}/LC_MESSAGES/tavro.mo")
    list(APPEND CPACK_RPM_EXCLUDE_FROM_AUTO_FILELIST_ADDITION /usr/share/locale/${language}
         /usr/share/locale/${language}/LC_MESSAGES)
endforeach()
set(CPACK_RPM_PACKAGE_LICENSE "All rights reserved")
set(CPACK_RPM_SUPPORT-DEVELOPMENT_PACKAGE_GROUP Development/Libraries)
# Without the machine, the folder and the hour of the build; files as CMake has stripped them, which are Debian's too.
set(CPACK_RPM_SPEC_MORE_DEFINE
    "%define packager ${CPACK_PACKAGE_CONTACT}
%define _buildhost localhost
%define __brp_strip_comment_note %{nil}
%define use_source_date_epoch_as_buildtime 1
%define clamp_mtime_to_source_date_epoch 1
%define _build_id_links none")

include(metrics.cmake)

include(CPack)
