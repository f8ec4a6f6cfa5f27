# What `cmake --install` installs, and the Debian package made of it. The version is that of project().
include(GNUInstallDirs)
include(CMakePackageConfigHelpers)

# The library and the tool are all that is installed; tests and fuzz targets need not be built for it.
set(CMAKE_SKIP_INSTALL_ALL_DEPENDENCY ON)

# Debian's loader, pkg-config and CMake look into the folder of the architecture below every prefix.
if(EXISTS /etc/debian_version AND CMAKE_LIBRARY_ARCHITECTURE AND CMAKE_INSTALL_LIBDIR STREQUAL "lib")
    set(CMAKE_INSTALL_LIBDIR lib/${CMAKE_LIBRARY_ARCHITECTURE})
endif()
set(headers_dir ${CMAKE_INSTALL_INCLUDEDIR})
set(config_dir ${CMAKE_INSTALL_LIBDIR}/cmake/dpxlsx)

install(TARGETS dpxlsx EXPORT dpxlsx-targets LIBRARY DESTINATION ${CMAKE_INSTALL_LIBDIR})
set_target_properties(dpxlsx PROPERTIES EXPORT_NAME dpxlsx)
target_include_directories(dpxlsx INTERFACE $<INSTALL_INTERFACE:${headers_dir}>)
target_compile_features(dpxlsx INTERFACE cxx_std_17)

set(docs_dir ${CMAKE_INSTALL_DATADIR}/doc/dpxlsx)
install(FILES docs/host-guide.md docs/import-rules.md docs/security.md CHANGELOG.md
    DESTINATION ${docs_dir})
install(FILES examples/minimal_host.cpp examples/linked_host.cpp DESTINATION ${docs_dir}/examples)

if(DPXLSX_TOOL)
    # The tool finds the library that was installed with it, wherever the two are moved.
    file(RELATIVE_PATH tool_to_library /${CMAKE_INSTALL_BINDIR} /${CMAKE_INSTALL_LIBDIR})
    set_target_properties(dpxlsx_tool PROPERTIES INSTALL_RPATH "$ORIGIN/${tool_to_library}")
    install(TARGETS dpxlsx_tool RUNTIME DESTINATION ${CMAKE_INSTALL_BINDIR})
    install(FILES docs/dpxlsx.1 DESTINATION ${CMAKE_INSTALL_MANDIR}/man1)
    install(FILES docs/tool.md docs/tool.schema.json docs/many-workbooks.md DESTINATION ${docs_dir})
    install(FILES tools/completions/dpxlsx.bash RENAME dpxlsx
        DESTINATION ${CMAKE_INSTALL_DATADIR}/bash-completion/completions)
    install(FILES tools/completions/_dpxlsx DESTINATION ${CMAKE_INSTALL_DATADIR}/zsh/site-functions)
    install(FILES tools/completions/dpxlsx.fish
        DESTINATION ${CMAKE_INSTALL_DATADIR}/fish/vendor_completions.d)
endif()

# The interfaces, and the headers of the classes and functions that a host may link to by name with
# what those include.
file(GLOB host_headers RELATIVE ${PROJECT_SOURCE_DIR} CONFIGURE_DEPENDS model/host/*.h)
set(class_headers
    formats/date_time_variable_format.h
    formats/format_codes.h
    formats/fraction_variable_format.h
    formats/numeric_variable_format.h
    formats/percentage_variable_format.h
    formats/style.h
    formats/style_classification.h
    formats/text_variable_format.h
    model/collections.h
    model/columns.h
    model/formula.h
    model/rows.h
    model/string.h
    model/worksheet.h
    provider/excel_data_provider_base.h
    provider/temporary_directory.h
    provider/xlsx_data_provider.h
    readers/xlsx/excel_xlsx_reader.h
    readers/xml/cm_xml_cast.h
    readers/xml/xml_reader.h
    readers/xml2003/excel_xml_reader.h
    store/blank_rows.h
    store/cell_column.h
    store/date_time_recognition.h
    store/external_data_record.h
    store/number_recognition.h
    store/pooled_text.h
    store/read_options.h
    store/reading_rules.h
    store/text_cleaning.h
    store/worksheet_cells.h)
foreach(header IN LISTS host_headers class_headers)
    cmake_path(GET header PARENT_PATH folder)
    install(FILES ${header} DESTINATION ${headers_dir}/dpxlsx/${folder})
endforeach()

# find_package(dpxlsx CONFIG) gives the target dpxlsx::dpxlsx.
install(EXPORT dpxlsx-targets NAMESPACE dpxlsx:: DESTINATION ${config_dir})
configure_package_config_file(cmake/dpxlsx-config.cmake.in dpxlsx-config.cmake
    INSTALL_DESTINATION ${config_dir})
write_basic_package_version_file(${CMAKE_CURRENT_BINARY_DIR}/dpxlsx-config-version.cmake
    COMPATIBILITY SameMajorVersion)
install(FILES ${CMAKE_CURRENT_BINARY_DIR}/dpxlsx-config.cmake
              ${CMAKE_CURRENT_BINARY_DIR}/dpxlsx-config-version.cmake
    DESTINATION ${config_dir})

# pkg-config, with a prefix that is found from the file's own place.
file(RELATIVE_PATH pkgconfig_to_prefix /${CMAKE_INSTALL_LIBDIR}/pkgconfig /)
string(REGEX REPLACE "/$" "" pkgconfig_to_prefix "${pkgconfig_to_prefix}")
configure_file(cmake/dpxlsx.pc.in dpxlsx.pc @ONLY)
install(FILES ${CMAKE_CURRENT_BINARY_DIR}/dpxlsx.pc DESTINATION ${CMAKE_INSTALL_LIBDIR}/pkgconfig)

# `cpack --config BUILD/deb.cmake` makes the package. Under CPack's usual name the file would bring a
# build target "package" into every folder, where one of the fuzz targets has that name.
set(CPACK_OUTPUT_CONFIG_FILE ${CMAKE_BINARY_DIR}/deb.cmake)
set(CPACK_SOURCE_OUTPUT_CONFIG_FILE ${CMAKE_BINARY_DIR}/source-package.cmake)
set(CPACK_GENERATOR DEB)
set(CPACK_PACKAGE_NAME dpxlsx)
set(CPACK_PACKAGE_CONTACT "dpxlsx developers <dpxlsx@example.org>")
set(CPACK_PACKAGE_DESCRIPTION_SUMMARY ${PROJECT_DESCRIPTION})
set(CPACK_STRIP_FILES ON)
set(CPACK_PACKAGING_INSTALL_PREFIX /usr)
set(CPACK_DEBIAN_FILE_NAME DEB-DEFAULT)
set(CPACK_DEBIAN_PACKAGE_SECTION libs)
set(CPACK_PACKAGE_DESCRIPTION
"A shared library that a desktop statistics application loads to read Excel
workbooks as typed columns, with its headers, and the command-line tool dpxlsx.")
set(CPACK_DEBIAN_PACKAGE_SHLIBDEPS ON)
set(CPACK_DEBIAN_PACKAGE_GENERATE_SHLIBS ON)  # with the trigger that tells the loader
include(CPack)
