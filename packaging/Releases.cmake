# SPDX-License-Identifier: MIT
# quillmark_releases(FILE VERSION): reads the release list FILE and sets, in the caller,
# releases_xml (AppStream <release> elements) and releases_newest_date. Stops when the newest
# release is not VERSION.

function(_quillmark_add_release version date notes)
  # The notes' lines joined into one paragraph.
  string(REPLACE "\n" " " paragraph "${notes}")
  string(REPLACE "&" "&amp;" paragraph "${paragraph}")
  string(REPLACE "<" "&lt;" paragraph "${paragraph}")
  string(REPLACE ">" "&gt;" paragraph "${paragraph}")
  string(APPEND releases_xml
    "    <release version=\"${version}\" date=\"${date}\">\n"
    "      <description>\n        <p>${paragraph}</p>\n      </description>\n    </release>\n")
  set(releases_xml "${releases_xml}" PARENT_SCOPE)
endfunction()

function(quillmark_releases file version)
  set_property(DIRECTORY APPEND PROPERTY CMAKE_CONFIGURE_DEPENDS ${file})
  file(STRINGS ${file} lines)
  set(releases_xml "")
  set(current "")
  foreach(line IN LISTS lines)
    if(line MATCHES "^#")
      continue()
    elseif(line MATCHES "^([0-9][^ ]*) ([0-9][0-9][0-9][0-9]-[0-9][0-9]-[0-9][0-9])$")
      if(current)
        _quillmark_add_release(${current} ${current_date} "${notes}")
      elseif(NOT CMAKE_MATCH_1 STREQUAL version)
        message(FATAL_ERROR "${file}: the newest release is ${CMAKE_MATCH_1}, not ${version}")
      else()
        set(releases_newest_date ${CMAKE_MATCH_2} PARENT_SCOPE)
      endif()
      set(current ${CMAKE_MATCH_1})
      set(current_date ${CMAKE_MATCH_2})
      set(notes "")
    elseif(line MATCHES "^  (.+)$" AND current)
      if(notes)
        string(APPEND notes "\n")
      endif()
      string(APPEND notes "${CMAKE_MATCH_1}")
    endif()
  endforeach()
  if(NOT current)
    message(FATAL_ERROR "${file} lists no release")
  endif()
  _quillmark_add_release(${current} ${current_date} "${notes}")
  set(releases_xml "${releases_xml}" PARENT_SCOPE)
endfunction()
