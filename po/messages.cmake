# Run as a script by the targets `pot` and `check-messages`. Takes TASK (WRITE or CHECK), SOURCE (the
# folder with po/ and src/) and SCRATCH (a folder for files that are thrown away).
cmake_minimum_required(VERSION 3.25)

set(template po/kcmtarvex_mail.pot)
set(fresh ${SCRATCH}/kcmtarvex_mail.pot)

# The tools are looked for here and not when the build is set up, because it does not need them.
find_program(XGETTEXT xgettext REQUIRED)
file(GLOB sources RELATIVE ${SOURCE} ${SOURCE}/src/*/*.cpp ${SOURCE}/src/*/*.h)
file(MAKE_DIRECTORY ${SCRATCH})
# Without line numbers a reference does not change with every line that is put in above it. The
# tool's own header is left out, since it carries the time at which it was written.
execute_process(
  COMMAND ${XGETTEXT} --language=C++ --from-code=UTF-8 --keyword --keyword=translatable
    --add-location=file --no-wrap --omit-header --force-po --output=${SCRATCH}/messages ${sources}
  WORKING_DIRECTORY ${SOURCE}
  COMMAND_ERROR_IS_FATAL ANY)
file(READ ${SOURCE}/po/header.txt header)
file(READ ${SCRATCH}/messages messages)
string(STRIP "${messages}" messages)
file(WRITE ${fresh} "${header}\n${messages}\n")

if(TASK STREQUAL WRITE)
  configure_file(${fresh} ${SOURCE}/${template} COPYONLY)
  return()
endif()

execute_process(
  COMMAND ${CMAKE_COMMAND} -E compare_files ${fresh} ${SOURCE}/${template}
  RESULT_VARIABLE differs OUTPUT_QUIET ERROR_QUIET)
if(differs)
  # A line that begins with a blank is printed unbroken.
  message(FATAL_ERROR " ${template} is behind the source: build the target \"pot\" and commit it.")
endif()

find_program(MSGCMP msgcmp REQUIRED)
find_program(MSGFMT msgfmt REQUIRED)
file(GLOB catalogues RELATIVE ${SOURCE} ${SOURCE}/po/*.po)
foreach(catalogue IN LISTS catalogues)
  execute_process(
    COMMAND ${MSGCMP} ${catalogue} ${template}
    WORKING_DIRECTORY ${SOURCE}
    RESULT_VARIABLE differs)
  if(differs)
    message(FATAL_ERROR " ${catalogue} is behind ${template}: run \"msgmerge --update ${catalogue} ${template}\" and translate what is new or fuzzy.")
  endif()
  execute_process(
    COMMAND ${MSGFMT} --check-format --check-accelerators=& --output-file=${SCRATCH}/messages.mo
      ${catalogue}
    WORKING_DIRECTORY ${SOURCE}
    RESULT_VARIABLE differs)
  if(differs)
    message(FATAL_ERROR " ${catalogue} has errors: mend the texts named above.")
  endif()
endforeach()
