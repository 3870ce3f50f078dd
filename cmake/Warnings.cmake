# Warning flags shared by every target of the project.
function(kvveldra_warnings target)
  target_compile_options(${target} PRIVATE -Wall -Wextra)
  if(KVVELDRA_WERROR)
    target_compile_options(${target} PRIVATE -Werror)
  endif()
endfunction()
