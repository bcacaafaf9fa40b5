# cmake -P driver of the install test: installs BUILD_DIR into a prefix under WORK_DIR, checks the
# tree, registers the installed library with the installed tool, then builds host.c against the
# prefix by find_package and by pkg-config and runs each. Stops at the first step that fails.
foreach(var BUILD_DIR WORK_DIR HOST_SOURCE_DIR FORM_FILE VERSION LIBDIR BINDIR INCLUDEDIR DATADIR GENERATOR C_COMPILER)
  if(NOT DEFINED ${var})
    message(FATAL_ERROR "install test: ${var} is not set")
  endif()
endforeach()

set(prefix ${WORK_DIR}/prefix)
file(REMOVE_RECURSE ${WORK_DIR})
file(MAKE_DIRECTORY ${WORK_DIR}/config ${WORK_DIR}/pkg-config)

# Nothing of the user's: settings, registration and configuration all live in the scratch folder.
set(ENV{QT_QPA_PLATFORM} offscreen)
set(ENV{XDG_CONFIG_HOME} ${WORK_DIR}/config)
set(ENV{KARSTGRAPH_SETTINGS} ${WORK_DIR}/config/settings.ini)
set(ENV{KARSTGRAPH_REGISTRY} ${WORK_DIR}/config/registry.ini)
if(HOST_FLAGS)
  # The hosts are small test programs; what they leave at exit is not the component's leak.
  set(ENV{ASAN_OPTIONS} "$ENV{ASAN_OPTIONS}:detect_leaks=0")
endif()

function(step what)
  execute_process(COMMAND ${ARGN} RESULT_VARIABLE status OUTPUT_VARIABLE out ERROR_VARIABLE out)
  if(NOT status EQUAL 0)
    string(JOIN " " command ${ARGN})
    message(FATAL_ERROR "install test: ${what} failed (${status}):\n${command}\n${out}")
  endif()
  set(step_output "${out}" PARENT_SCOPE)
endfunction()

step("cmake --install" ${CMAKE_COMMAND} --install ${BUILD_DIR} --prefix ${prefix})
foreach(file ${LIBDIR}/libkarstgraph.so ${INCLUDEDIR}/karstgraph/karstgraph.h
             ${LIBDIR}/cmake/KarstGraph/KarstGraphConfigVersion.cmake ${LIBDIR}/pkgconfig/karstgraph.pc
             ${BINDIR}/karstgraph ${DATADIR}/karstgraph/Help/chartctl.hlp)
  if(NOT EXISTS ${prefix}/${file})
    message(FATAL_ERROR "install test: the installation has no ${file} (prefix ${prefix})")
  endif()
endforeach()

step("the installed tool's describe" ${prefix}/${BINDIR}/karstgraph describe)
step("the installed tool's register"
     ${prefix}/${BINDIR}/karstgraph register --library ${prefix}/${LIBDIR}/libkarstgraph.so)

# (a) a CMake project that knows only the package
set(sub ${WORK_DIR}/find_package)
step("configuring the find_package host" ${CMAKE_COMMAND} -S ${HOST_SOURCE_DIR}/find_package -B ${sub}
     -G ${GENERATOR} -DCMAKE_MAKE_PROGRAM=${MAKE_PROGRAM} -DCMAKE_C_COMPILER=${C_COMPILER}
     "-DCMAKE_C_FLAGS=${HOST_FLAGS}" "-DCMAKE_EXE_LINKER_FLAGS=${HOST_LINK_FLAGS}"
     -DCMAKE_PREFIX_PATH=${prefix} -DKARSTGRAPH_VERSION=${VERSION} -DCMAKE_FIND_PACKAGE_NO_PACKAGE_REGISTRY=ON)
file(STRINGS ${sub}/CMakeCache.txt found REGEX "^KarstGraph_DIR:")
if(NOT found STREQUAL "KarstGraph_DIR:PATH=${prefix}/${LIBDIR}/cmake/KarstGraph")
  message(FATAL_ERROR "install test: the host found another KarstGraph package: ${found}")
endif()
step("building the find_package host" ${CMAKE_COMMAND} --build ${sub})
step("running the find_package host" ${sub}/host ${FORM_FILE})

# (b) the C compiler and pkg-config alone
set(ENV{PKG_CONFIG_PATH} ${prefix}/${LIBDIR}/pkgconfig)
step("pkg-config --cflags --libs" pkg-config --cflags --libs karstgraph)
separate_arguments(pc_flags UNIX_COMMAND "${step_output}")
step("pkg-config --variable=libdir" pkg-config --variable=libdir karstgraph)
string(STRIP "${step_output}" pc_libdir)
separate_arguments(host_flags UNIX_COMMAND "${HOST_FLAGS}")
separate_arguments(host_link_flags UNIX_COMMAND "${HOST_LINK_FLAGS}")
step("building the pkg-config host" ${C_COMPILER} -std=c11 ${host_flags} ${HOST_SOURCE_DIR}/host.c ${pc_flags}
     ${host_link_flags} -Wl,-rpath,${pc_libdir} -o ${WORK_DIR}/pkg-config/host)
step("running the pkg-config host" ${WORK_DIR}/pkg-config/host ${FORM_FILE})

message(STATUS "install test: both hosts charted from ${prefix}")
