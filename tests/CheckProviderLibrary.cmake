# Holds the built provider library to what brokers and makers rely on. Run as
#   cmake -DLIBRARY=FILE -DREADELF=... -DNM=... -P THIS

cmake_minimum_required(VERSION 3.20)

include(${CMAKE_CURRENT_LIST_DIR}/../cmake/RunTool.cmake)

# What it is linked with: the four support libraries and run-time libraries, nothing else. The loader and thread
# libraries are part of the C library on newer systems; sanitizers bring their own run time.
run_tool(dynamic ${READELF} -d ${LIBRARY})
string(REGEX MATCHALL "\\(NEEDED\\)[^\n]*\\[[^]]*\\]" needed "${dynamic}")
list(TRANSFORM needed REPLACE ".*\\[(.*)\\]" "\\1")
set(support libtavro-instrumentation.so.1 libtavro-common.so.1 libtavro-locale.so.1 libmvlog.so.1)
foreach(library IN LISTS support)
    if(NOT library IN_LIST needed)
        message(SEND_ERROR "Not linked with ${library}")
    endif()
endforeach()
list(REMOVE_ITEM needed ${support})
list(FILTER needed EXCLUDE REGEX
     "^(libstdc\\+\\+|libgcc_s|libc|libm|libdl|libpthread|ld-linux[a-z0-9-]*|ld64|libasan|libubsan|libtsan)\\.so\\.[0-9]+$")
if(needed)
    message(SEND_ERROR "Linked with what it should not be: ${needed}")
endif()

# A support library named by LD_LIBRARY_PATH comes before the ones of the build: RUNPATH, not RPATH.
if(dynamic MATCHES "\\(RPATH\\)")
    message(SEND_ERROR "Has an RPATH, which stands before LD_LIBRARY_PATH")
endif()

# The six entry points by their plain names, and nothing else without a mangled one: no function, no variable.
run_tool(symbols ${NM} --dynamic --defined-only --format=posix ${LIBRARY})
string(REGEX MATCHALL "[^ \n]+ [A-Za-z] " exported "${symbols}")
list(TRANSFORM exported REPLACE " .*" "")
set(plain ${exported})
list(FILTER plain EXCLUDE REGEX "^(_Z|__gcov_|mangle_path$)") # the latter two of a coverage build
list(SORT plain)
set(expected
    GlimmarkCapabilitiesProvider_Create_InstanceMI
    GlimmarkElementCapabilitiesProvider_Create_AssociationMI
    GlimmarkElementCapabilitiesProvider_Create_InstanceMI
    GlimmarkProfileProvider_Create_InstanceMI
    GlimmarkSystemDeviceProvider_Create_AssociationMI
    GlimmarkSystemDeviceProvider_Create_InstanceMI)
if(NOT plain STREQUAL expected)
    message(SEND_ERROR "Entry points:\n${plain}\nexpected:\n${expected}")
endif()

# It can be unloaded: no symbol is unique in the process.
string(REGEX MATCHALL "[^ \n]+ u " unique "${symbols}")
if(unique)
    message(SEND_ERROR "Symbols that keep the library loaded: ${unique}")
endif()

# Every other function keeps default visibility: one of each kind stands for them.
foreach(name IN ITEMS
        _ZN5Tavro16GlimmarkProvider22Glimmark_EnumInstancesEP15_CMPIInstanceMIPK12_CMPIContextPK11_CMPIResultPK15_CMPIObjectPathPPKc
        _ZN5Tavro16GlimmarkProvider9setVectorERSt6vectorINS0_8GlimmarkESaIS2_EERNS_15InstrumentationE
        _ZN5Tavro9traceparaEPKcS1_jS1_NS_11MessageTypeE
        _ZN5Tavro5traceEPKcS1_jNS_11MessageTypeE)
    if(NOT name IN_LIST exported)
        message(SEND_ERROR "Not visible: ${name}")
    endif()
endforeach()
