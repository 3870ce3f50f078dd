#ifndef KVVELDRA_WBTYPES_H
#define KVVELDRA_WBTYPES_H

/* The graphical host's data forms, as they cross the TagWB* interface. */

#include <stdint.h>

#ifdef __cplusplus
extern "C" {
#endif

/* A counted string in the host's memory manager: a signed 32-bit length and
 * that many bytes, with no terminator. A handle is a pointer to a pointer to
 * the block; a null handle reads as the empty string. */
typedef struct WBStr {
    int32_t cnt;
    unsigned char str[1];
} WBStr;
typedef WBStr** WBStrHandle;

/* Any handle of the host: a pointer to a pointer to a block. */
typedef void** WBHandle;

/* The host's absolute time: whole seconds since 1904-01-01 00:00:00 UTC and a
 * binary fraction of a second in units of 2^-64, the fraction first. */
typedef struct WBTimestamp {
    uint64_t fraction;
    int64_t seconds;
} WBTimestamp;

/* A variant of the host, reached only through the WbVariant* functions. */
typedef struct WbVariant WbVariant;

#ifdef __cplusplus
}
#endif

#endif
