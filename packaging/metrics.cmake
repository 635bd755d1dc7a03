# The package glimmark-metrics: what writes the indicators for Prometheus every minute, and the alert rules.
#
# Nothing of it is compiled, and all of it stands where the system looks: it is installed by the package alone.

set(units ${PROJECT_SOURCE_DIR}/metrics/systemd)

# install_metrics(DESTINATION FILE [NAME])
function(install_metrics destination file)
    get_filename_component(name ${file} NAME)
    if(ARGC GREATER 2)
        set(name ${ARGV2})
    endif()
    install(
        FILES ${file}
        DESTINATION ${destination}
        RENAME ${name}
        COMPONENT metrics
        EXCLUDE_FROM_ALL)
endfunction()

# Distributions with RPM have everything below /usr; Debian 12 keeps units where they were before.
if(GLIMMARK_PACKAGES STREQUAL "DEB")
    set(unitdir /lib/systemd/system)
else()
    set(unitdir /usr/lib/systemd/system)
endif()
install_metrics(${unitdir} ${units}/glimmark-metrics.service)
install_metrics(${unitdir} ${units}/glimmark-metrics.timer)
install_metrics(/usr/lib/sysusers.d ${units}/glimmark-metrics.sysusers glimmark-metrics.conf)
install_metrics(${CMAKE_INSTALL_DATAROOTDIR}/glimmark-metrics ${PROJECT_SOURCE_DIR}/metrics/glimmark.rules.yml)

glimmark_package(
    metrics glimmark-metrics admin "server's diagnostic indicators for Prometheus"
    "Writes the state of the indicators into a file for Prometheus' node exporter
every minute, by a service without privileges. The alert rules come along.")

set(CPACK_DEBIAN_METRICS_PACKAGE_ARCHITECTURE all)
set(CPACK_DEBIAN_METRICS_PACKAGE_SHLIBDEPS OFF)
set(CPACK_DEBIAN_METRICS_PACKAGE_DEPENDS
    "cimhost, glimmark-provider, init-system-helpers (>= 1.54), systemd | systemd-standalone-sysusers | systemd-sysusers")
set(CPACK_DEBIAN_METRICS_PACKAGE_RECOMMENDS prometheus-node-exporter)
set(scripts ${CMAKE_CURRENT_SOURCE_DIR}/metrics)
set(CPACK_DEBIAN_METRICS_PACKAGE_CONTROL_EXTRA ${scripts}/postinst ${scripts}/prerm ${scripts}/postrm)

set(CPACK_RPM_METRICS_PACKAGE_ARCHITECTURE noarch)
set(CPACK_RPM_METRICS_PACKAGE_REQUIRES "cimhost, glimmark-provider, systemd")
set(CPACK_RPM_METRICS_POST_INSTALL_SCRIPT_FILE ${scripts}/post)
set(CPACK_RPM_METRICS_PRE_UNINSTALL_SCRIPT_FILE ${scripts}/preun)
set(CPACK_RPM_METRICS_POST_UNINSTALL_SCRIPT_FILE ${scripts}/postun)
list(APPEND CPACK_RPM_EXCLUDE_FROM_AUTO_FILELIST_ADDITION /usr/lib /usr/lib/systemd /usr/lib/systemd/system
     /usr/lib/sysusers.d)
