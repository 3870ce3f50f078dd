#ifndef KVVELDRA_EXPORT_H
#define KVVELDRA_EXPORT_H

/* Marks the functions that the shared library exports. Everything else in it
 * has hidden visibility. */
#if defined(KVVELDRA_BUILDING_LIBRARY)
#define KVVELDRA_API __attribute__((visibility("default")))
#else
#define KVVELDRA_API
#endif

#ifdef __cplusplus
#define KVVELDRA_EXTERN_C extern "C"
#else
#define KVVELDRA_EXTERN_C
#endif

#endif
