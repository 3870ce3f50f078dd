/* The shared library is made of the core archive; this unit only gives the
 * target a source of its own. */
typedef int kvveldra_library_entry_unit;
