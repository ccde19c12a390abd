# Writes the side-by-side assembly of the control library to OUTPUT: what the registration writes, read from IDL.
# NAME, VERSION (four numbers) and ARCHITECTURE are the assembly's; FILE is the library beside it.
cmake_minimum_required(VERSION 3.25)
file(READ ${IDL} text)
string(REGEX REPLACE "//[^\n]*" "" text "${text}")
string(REPLACE ";" " " text "${text}")

# What has an identifier of its own: its attributes in brackets, its kind and its name.
string(REGEX MATCHALL "\\[[^]]*uuid[^]]*\\][ \n]*(library|interface|dispinterface|coclass)[ ]+[A-Za-z_]+" things "${text}")

set(MISC_STATUS "recomposeonresize,cantlinkinside,insideout,activatewhenvisible,setclientsitefirst")
# Who marshals for the system.
set(PROXY_OF_interface "{00020424-0000-0000-C000-000000000046}")
set(PROXY_OF_dispinterface "{00020420-0000-0000-C000-000000000046}")

foreach(thing IN LISTS things)
  string(REGEX MATCH "uuid\\(([^)]*)\\)" uuid "${thing}")
  string(TOUPPER "{${CMAKE_MATCH_1}}" uuid)
  string(REGEX MATCH "helpstring\\(\"([^\"]*)\"\\)" help "${thing}")
  set(help "${CMAKE_MATCH_1}")
  string(REGEX MATCH "([a-z]+)[ ]+([A-Za-z_]+)$" declared "${thing}")
  set(kind ${CMAKE_MATCH_1})
  set(name ${CMAKE_MATCH_2})
  if(kind STREQUAL "library")
    string(REGEX MATCH "version\\((([0-9]+)[.0-9]*)\\)" version "${thing}")
    set(library_version ${CMAKE_MATCH_1})
    set(library_major ${CMAKE_MATCH_2})
    set(library_name ${name})
    set(library_uuid ${uuid})
  elseif(kind STREQUAL "coclass")
    set(status "")
    if(thing MATCHES "[, ]control[],]")
      set(status "\n              miscStatusContent=\"${MISC_STATUS}\"")
    endif()
    string(APPEND classes
      "    <comClass description=\"${help}\" clsid=\"${uuid}\"\n"
      "              tlbid=\"${library_uuid}\" threadingModel=\"Apartment\"\n"
      "              progid=\"${library_name}.${name}.${library_major}\"${status}>\n"
      "      <progid>${library_name}.${name}</progid>\n"
      "    </comClass>\n")
  else()
    string(APPEND proxies
      "  <comInterfaceExternalProxyStub name=\"${name}\" iid=\"${uuid}\"\n"
      "                                 tlbid=\"${library_uuid}\"\n"
      "                                 proxyStubClsid32=\"${PROXY_OF_${kind}}\"/>\n")
  endif()
endforeach()

file(WRITE ${OUTPUT}
  "<?xml version=\"1.0\" encoding=\"UTF-8\" standalone=\"yes\"?>\n"
  "<assembly xmlns=\"urn:schemas-microsoft-com:asm.v1\" manifestVersion=\"1.0\">\n"
  "  <assemblyIdentity type=\"win32\" name=\"${NAME}\" version=\"${VERSION}\" processorArchitecture=\"${ARCHITECTURE}\"/>\n"
  "  <file name=\"${FILE}\">\n"
  "    <typelib tlbid=\"${library_uuid}\" version=\"${library_version}\" helpdir=\"\" flags=\"control,hasdiskimage\"/>\n"
  "${classes}  </file>\n${proxies}</assembly>\n")
