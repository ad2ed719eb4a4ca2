# Writes the man page of ardcard from what `ardcard --help` and
# `ardcard --version` print, so that the two never tell different stories.
#   cmake -DARDCARD=path/to/ardcard -DOUTPUT=ardcard.1 -P make_manpage.cmake
#
# The help text is read as: a "Usage: " line, a paragraph saying what the
# program does, then sections each headed by a line ending in ":". In the
# "Options:" section an entry starts with two spaces and "--", and lines
# indented further continue it.

execute_process(COMMAND ${ARDCARD} --help OUTPUT_VARIABLE help RESULT_VARIABLE rc1)
execute_process(COMMAND ${ARDCARD} --version OUTPUT_VARIABLE version RESULT_VARIABLE rc2)
if(NOT rc1 EQUAL 0 OR NOT rc2 EQUAL 0)
  message(FATAL_ERROR "ardcard --help/--version failed: ${rc1} ${rc2}")
endif()
string(STRIP "${version}" version)
string(REPLACE "ardcard " "" number "${version}")

# roff: a backslash is written as \e, a minus as \-, and a line may not begin
# with a dot or an apostrophe.
function(roff_escape text out)
  string(REPLACE "\\" "\\e" text "${text}")
  string(REPLACE "-" "\\-" text "${text}")
  if(text MATCHES "^[.']")
    set(text "\\&${text}")
  endif()
  set(${out} "${text}" PARENT_SCOPE)
endfunction()

string(REPLACE ";" "\\;" help "${help}")
string(REPLACE "\n" ";" lines "${help}")

set(page ".TH ARDCARD 1 \"\" \"ardcard ${number}\" \"User Commands\"\n")
string(APPEND page ".SH NAME\nardcard \\- the Ardeco account card\n")
set(state start)
foreach(line IN LISTS lines)
  if(state STREQUAL start AND line MATCHES "^Usage: ardcard (.*)$")
    roff_escape("${CMAKE_MATCH_1}" rest)
    string(APPEND page ".SH SYNOPSIS\n.B ardcard\n${rest}\n.br\n.B ardcard\n\\-\\-help | \\-\\-version\n.SH DESCRIPTION\n")
    set(state description)
  elseif(line STREQUAL "")
    if(state STREQUAL "option")
      set(state section)
    endif()
  elseif(line MATCHES "^([A-Z][A-Za-z ]*):$")
    string(TOUPPER "${CMAKE_MATCH_1}" heading)
    string(APPEND page ".SH ${heading}\n")
    if(heading STREQUAL "OPTIONS")
      set(state options)
    else()
      set(state section)
    endif()
  elseif((state STREQUAL options OR state STREQUAL option)
         AND line MATCHES "^  (--[a-z-]+)( [A-Z=]+)?  +(.*)$")
    set(flag "${CMAKE_MATCH_1}")
    set(arg "${CMAKE_MATCH_2}")
    roff_escape("${flag}" flag)
    roff_escape("${CMAKE_MATCH_3}" text)
    string(STRIP "${arg}" arg)
    if(arg)
      string(APPEND page ".TP\n.BI \"${flag} \" ${arg}\n${text}\n")
    else()
      string(APPEND page ".TP\n.B ${flag}\n${text}\n")
    endif()
    set(state option)
  else()
    string(STRIP "${line}" text)
    roff_escape("${text}" text)
    string(APPEND page "${text}\n")
  endif()
endforeach()
file(WRITE ${OUTPUT} "${page}")
