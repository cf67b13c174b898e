# Fails when libhqf.so shows a symbol that is no part of its interface, or nothing of it at all.
execute_process(COMMAND ${NM} -D -C --defined-only ${LIBRARY} OUTPUT_VARIABLE symbols COMMAND_ERROR_IS_FATAL ANY)

set(what "(vtable for |typeinfo for |typeinfo name for |VTT for |guard variable for |non-virtual thunk to )?")
set(names
  "hqf_v2::" # the model
  "lmx::" # the runtime
  "hqf::frame::pooled(::|$)" # where the model's objects lie
  "hqf::equal\\(" # the one operation of our own on model classes
  "(CZip|ZipArchiveLib::)" # archives
  "(CSharp_|SWIGRegister|hqf_[A-Za-z_]+$)" # the flat layer, whose names the test flat.symbols compares one by one
  "Sys(AllocStringLen|AllocStringByteLen|FreeString|StringLen|StringByteLen)$" # strings for managed callers
  "std::" # instances of templates of the standard library, which it makes visible itself
)
list(JOIN names "|" names)

string(REPLACE ";" "," symbols "${symbols}")
string(REPLACE "[" "(" symbols "${symbols}") # brackets would join the items of a list
string(REPLACE "]" ")" symbols "${symbols}")
string(REPLACE "\n" ";" symbols "${symbols}")
set(alien "")
foreach(symbol ${symbols})
  string(REGEX REPLACE "^[0-9a-f]+ [A-Za-z] " "" symbol "${symbol}")
  if(NOT symbol MATCHES "^${what}(${names})")
    string(APPEND alien "  ${symbol}\n")
  endif()
endforeach()
if(alien)
  message(FATAL_ERROR "Symbols that are no part of the interface:\n${alien}")
endif()

foreach(needed "hqf_v2::Hqf::loadFile(" "vtable for lmx::c_xml_reader" "hqf::equal(hqf_v2::Hqf const&" "CZipArchive::Open(")
  string(FIND "${symbols}" "${needed}" place)
  if(place EQUAL -1)
    message(FATAL_ERROR "${needed} is not exported")
  endif()
endforeach()
