# RELEASE_DATE (2026-11-22) and RELEASE_TIME (Sun, 22 Nov 2026 08:00:00 +0000): when what is built was last changed, so
# that the same sources always say the same. SOURCE_DATE_EPOCH stands before the time of the last commit.
set(seconds "$ENV{SOURCE_DATE_EPOCH}")
if(seconds STREQUAL "")
  execute_process(COMMAND git log -1 --format=%ct WORKING_DIRECTORY "${CMAKE_SOURCE_DIR}"
                  OUTPUT_VARIABLE seconds OUTPUT_STRIP_TRAILING_WHITESPACE ERROR_QUIET)
endif()
if(seconds STREQUAL "") # sources from an archive
  file(TIMESTAMP "${CMAKE_SOURCE_DIR}/CHANGELOG.md" seconds "%s" UTC)
endif()
foreach(form "RELEASE_DATE=%Y-%m-%d" "RELEASE_TIME=%a, %d %b %Y %H:%M:%S +0000")
  string(REPLACE "=" ";" both "${form}")
  list(POP_FRONT both name format)
  execute_process(COMMAND ${CMAKE_COMMAND} -E env LC_ALL=C date --utc "--date=@${seconds}" "+${format}"
                  OUTPUT_VARIABLE ${name} OUTPUT_STRIP_TRAILING_WHITESPACE COMMAND_ERROR_IS_FATAL ANY)
endforeach()
