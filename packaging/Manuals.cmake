# Man pages and completions. The shell program generates its own from its table of options.
find_program(GAITWRIGHT_GZIP gzip REQUIRED)

# installed_text(FILE COMPONENT FOLDER command...): installs the output of a command as a file. A name in .gz is
# compressed reproducibly.
function(installed_text file component folder)
  set(text ${CMAKE_CURRENT_BINARY_DIR}/texts/${file})
  cmake_path(REMOVE_EXTENSION text LAST_ONLY OUTPUT_VARIABLE plain)
  cmake_path(GET text PARENT_PATH parent)
  file(MAKE_DIRECTORY ${parent})
  if(file MATCHES "\\.gz$")
    set(print ${ARGN} > ${plain} COMMAND ${GAITWRIGHT_GZIP} -9nf ${plain})
  else()
    set(print ${ARGN} > ${text})
  endif()
  set(inputs ${ARGN})
  list(FILTER inputs INCLUDE REGEX "^/")
  add_custom_command(OUTPUT ${text} COMMAND ${print} DEPENDS ${inputs} VERBATIM)
  install(FILES ${text} DESTINATION ${folder} COMPONENT ${component})
  set_property(TARGET texts APPEND PROPERTY SOURCES ${text})
endfunction()

add_custom_target(texts ALL)
set(man ${CMAKE_INSTALL_MANDIR}/man1)
installed_text(gaitwright.1.gz shell ${man} gaitwright --man-page)
configure_file(GaitForge.1.in GaitForge.1 @ONLY)
installed_text(GaitForge.1.gz desktop ${man} ${CMAKE_COMMAND} -E cat ${CMAKE_CURRENT_BINARY_DIR}/GaitForge.1)

set(share ${CMAKE_INSTALL_DATADIR})
installed_text(bash/gaitwright shell ${share}/bash-completion/completions gaitwright --completion bash)
installed_text(zsh/_gaitwright shell ${share}/zsh/vendor-completions gaitwright --completion zsh)
installed_text(fish/gaitwright.fish shell ${share}/fish/vendor_completions.d gaitwright --completion fish)

# Required by Debian: copyright and changelog.
configure_file(changelog.in changelog @ONLY)
foreach(component package IN ZIP_LISTS GAITWRIGHT_COMPONENTS GAITWRIGHT_PACKAGES)
  set(documents ${CMAKE_INSTALL_DATADIR}/doc/${package})
  install(FILES copyright DESTINATION ${documents} COMPONENT ${component})
  installed_text(${package}/changelog.gz ${component} ${documents}
                 ${CMAKE_COMMAND} -E cat ${CMAKE_CURRENT_BINARY_DIR}/changelog)
  if(EXISTS ${CMAKE_CURRENT_SOURCE_DIR}/${package}.lintian)
    install(FILES ${package}.lintian DESTINATION share/lintian/overrides RENAME ${package} COMPONENT ${component})
  endif()
endforeach()
