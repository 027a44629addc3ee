# Turns one edition of the manual into a page for a browser:
#
#     cmake -D CMARK=PROGRAM -D SOURCE=manual.md -D FRAME=manual.html.in -D LANGUAGE=en -D PAGE=manual.html -P ManualPage.cmake
#
# FRAME is what stands around the text. Headings get the identifiers that links to them use, which the converter leaves out.
execute_process(
  COMMAND ${CMARK} --extension table ${SOURCE}
  OUTPUT_VARIABLE text
  COMMAND_ERROR_IS_FATAL ANY)

string(REGEX MATCHALL "<h[1-6]>[^<]*</h[1-6]>" headings "${text}")
foreach(heading IN LISTS headings)
  string(REGEX REPLACE "<[^>]*>" "" title "${heading}")
  string(TOLOWER "${title}" identifier)
  string(REGEX REPLACE "[.,:!?'\"()/]" "" identifier "${identifier}")
  string(REPLACE " " "-" identifier "${identifier}")
  string(REGEX REPLACE "^<(h[1-6])>" "<\\1 id=\"${identifier}\">" anchored "${heading}")
  string(REPLACE "${heading}" "${anchored}" text "${text}")
endforeach()

string(REGEX MATCH "<h1[^>]*>([^<]*)</h1>" title "${text}")
set(TITLE "${CMAKE_MATCH_1}")
set(TEXT "${text}")
file(READ ${FRAME} frame)
string(CONFIGURE "${frame}" page @ONLY)
file(WRITE ${PAGE} "${page}")
