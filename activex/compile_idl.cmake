# Compiles IDL to OUTPUT/frontpanels.tlb and OUTPUT/frontpanels_h.h; fails when the compiler says anything.
foreach(arguments "-t;-L;${STDOLE_FOLDER};-o;${OUTPUT}/frontpanels.tlb" "-h;-o;${OUTPUT}/frontpanels_h.h")
  execute_process(COMMAND ${WIDL} ${arguments} ${IDL}
    RESULT_VARIABLE result OUTPUT_VARIABLE said ERROR_VARIABLE said)
  if(NOT result EQUAL 0 OR NOT said STREQUAL "")
    message(FATAL_ERROR "${WIDL}: ${said}")
  endif()
endforeach()
