# kvveldra_gzip(FILE OUT_VAR): compresses FILE into the build tree as Debian
# wants manual pages and changelogs, with gzip -9 -n: no name or time stamp in
# the header, so that two builds of the same file give the same bytes. Sets
# OUT_VAR to the .gz file, which the "all" build makes.
include_guard(GLOBAL)

file(MAKE_DIRECTORY ${PROJECT_BINARY_DIR}/gzip)

function(kvveldra_gzip file out_var)
  get_filename_component(name ${file} NAME)
  set(out ${PROJECT_BINARY_DIR}/gzip/${name}.gz)
  add_custom_command(OUTPUT ${out}
    COMMAND gzip -9 -n -c ${file} > ${out}
    DEPENDS ${file}
    VERBATIM)
  add_custom_target(gzip_${name} ALL DEPENDS ${out})
  set(${out_var} ${out} PARENT_SCOPE)
endfunction()
