#ifndef KVVELDRA_WBTYPES_H
#define KVVELDRA_WBTYPES_H

/* The graphical host's data forms, as they cross the TagWB* interface.
 *
 * Every form is defined once here, for the pointer width of the build. The
 * fields keep their order in every width and take their natural alignment:
 * handles, variant pointers and the other pointer-sized slots are 4 bytes
 * wide in a 32-bit process and 8 bytes in a 64-bit one, and whatever follows
 * them moves along. An array block holds a signed 32-bit count, then its
 * elements, which start at the first offset that suits their alignment: byte
 * 4 for 4-byte elements, byte 8 for pointers in a 64-bit process and for
 * anything that holds a timestamp or a double. The offsets of both widths are
 * listed beside each form and checked at compile time (see the end of the
 * file). All data is little-endian. */

#include <stddef.h>
#include <stdint.h>

#ifdef __cplusplus
extern "C" {
#endif

/* Timestamps and doubles sit on 8-byte boundaries in every width, as the
 * host lays them out, also where the processor's own rule would allow 4. */
#if defined(__GNUC__)
#define KVVELDRA_WB_ALIGN8 __attribute__((aligned(8)))
#else
#define KVVELDRA_WB_ALIGN8
#endif

/* Any handle of the host: a pointer to a pointer to a block in the host's
 * memory manager. */
typedef void** WBHandle;

/* A counted string: a signed 32-bit length and that many bytes, with no
 * terminator. A null handle and a length of 0 both read as the empty string.
 *   cnt 0 (4), str 4 */
typedef struct WBStr {
    int32_t cnt;
    unsigned char str[1];
} WBStr;
typedef WBStr** WBStrHandle;

/* The host's absolute time: whole seconds since 1904-01-01 00:00:00 UTC and a
 * binary fraction of a second in units of 2^-64, the fraction first. All zero
 * stands for "no timestamp" where a timestamp goes in.
 *   fraction 0 (8), seconds 8 (8); size 16 */
typedef struct KVVELDRA_WB_ALIGN8 WBTimestamp {
    uint64_t fraction;
    int64_t seconds;
} WBTimestamp;

/* A variant of the host, reached only through the WbVariant* functions. */
typedef struct WbVariant WbVariant;

/* A key and a value, the element of a property array.
 *   32-bit: key 0, value 4; size 8.   64-bit: key 0, value 8; size 16 */
typedef struct WBProperty {
    WBStrHandle key;
    WBStrHandle value;
} WBProperty;

/* One tag's value, the element of the value arrays of the Multi functions.
 * WBValue carries the value as a variant, WBValue2 (the "2" functions) as a
 * string handle; the layouts are the same.
 *   32-bit: path 0, dataType 4, value 8, padding 12, timestamp 16; size 32
 *   64-bit: path 0, dataType 8, padding 12, value 16, timestamp 24; size 40 */
typedef struct WBValue {
    WBStrHandle path;
    int32_t dataType; /* 0 Double, 1 Int, 2 String, 3 Boolean, 4 UInt64, 5 DateTime */
    WbVariant* value;
    WBTimestamp timestamp;
} WBValue;
typedef struct WBValue2 {
    WBStrHandle path;
    int32_t dataType;
    WBStrHandle value;
    WBTimestamp timestamp;
} WBValue2;

/* The aggregates of a single read as numbers (TagWBFinishRead).
 *   count 0, max 8, min 16, avg 24; size 32 in both widths */
typedef struct WBAggregates {
    uint32_t count;
    double max KVVELDRA_WB_ALIGN8;
    double min KVVELDRA_WB_ALIGN8;
    double avg KVVELDRA_WB_ALIGN8;
} WBAggregates;

/* The aggregates of a single read with max and min as text (TagWBFinishRead2).
 *   32-bit: count 0, max 4, min 8, avg 16; size 24
 *   64-bit: count 0, max 8, min 16, avg 24; size 32 */
typedef struct WBAggregates2 {
    uint32_t count;
    WBStrHandle max;
    WBStrHandle min;
    double avg KVVELDRA_WB_ALIGN8;
} WBAggregates2;

/* The array forms. Each holds `dimSize` elements from `elt` on; the host
 * allocates the block to the size of its elements.
 *                       elt at (32-bit / 64-bit)   element size (32 / 64) */
typedef struct WBStrArray { /*   4 / 8                  4 / 8  */
    int32_t dimSize;
    WBStrHandle elt[1];
} WBStrArray;
typedef struct WBPropertyArray { /* 4 / 8               8 / 16 */
    int32_t dimSize;
    WBProperty elt[1];
} WBPropertyArray;
typedef struct WBReferenceArray { /* 4 / 4              4 / 4  */
    int32_t dimSize;
    uint32_t elt[1];
} WBReferenceArray;
typedef struct WBTypeArray { /*   4 / 4                  4 / 4  */
    int32_t dimSize;
    int32_t elt[1];
} WBTypeArray;
typedef struct WBTimestampArray { /* 8 / 8              16 / 16 */
    int32_t dimSize;
    WBTimestamp elt[1];
} WBTimestampArray;
typedef struct WBVariantArray { /* 4 / 8                4 / 8  */
    int32_t dimSize;
    WbVariant* elt[1];
} WBVariantArray;
typedef struct WBValueArray { /*  8 / 8                  32 / 40 */
    int32_t dimSize;
    WBValue elt[1];
} WBValueArray;
typedef struct WBValueArray2 { /* 8 / 8                  32 / 40 */
    int32_t dimSize;
    WBValue2 elt[1];
} WBValueArray2;

typedef WBStrArray** WBStrArrayHandle;
typedef WBPropertyArray** WBPropertyArrayHandle;
typedef WBReferenceArray** WBReferenceArrayHandle;
typedef WBTypeArray** WBTypeArrayHandle;
typedef WBTimestampArray** WBTimestampArrayHandle;
typedef WBVariantArray** WBVariantArrayHandle;
typedef WBValueArray** WBValueArrayHandle;
typedef WBValueArray2** WBValueArray2Handle;

/* The layouts above, checked wherever the compiler can (C++11, C11). */
#if defined(__cplusplus)
#define KVVELDRA_WB_LAYOUT(condition) static_assert(condition, #condition)
#elif defined(__STDC_VERSION__) && __STDC_VERSION__ >= 201112L
#define KVVELDRA_WB_LAYOUT(condition) _Static_assert(condition, #condition)
#endif

#ifdef KVVELDRA_WB_LAYOUT
#if UINTPTR_MAX == 0xFFFFFFFFu
#define KVVELDRA_WB_PICK(bits32, bits64) (bits32)
#else
#define KVVELDRA_WB_PICK(bits32, bits64) (bits64)
#endif
KVVELDRA_WB_LAYOUT(offsetof(WBStr, str) == 4);
KVVELDRA_WB_LAYOUT(offsetof(WBTimestamp, fraction) == 0);
KVVELDRA_WB_LAYOUT(offsetof(WBTimestamp, seconds) == 8);
KVVELDRA_WB_LAYOUT(sizeof(WBTimestamp) == 16);
KVVELDRA_WB_LAYOUT(offsetof(WBProperty, value) == KVVELDRA_WB_PICK(4, 8));
KVVELDRA_WB_LAYOUT(sizeof(WBProperty) == KVVELDRA_WB_PICK(8, 16));
KVVELDRA_WB_LAYOUT(offsetof(WBValue, dataType) == KVVELDRA_WB_PICK(4, 8));
KVVELDRA_WB_LAYOUT(offsetof(WBValue, value) == KVVELDRA_WB_PICK(8, 16));
KVVELDRA_WB_LAYOUT(offsetof(WBValue, timestamp) == KVVELDRA_WB_PICK(16, 24));
KVVELDRA_WB_LAYOUT(sizeof(WBValue) == KVVELDRA_WB_PICK(32, 40));
KVVELDRA_WB_LAYOUT(offsetof(WBValue2, dataType) == offsetof(WBValue, dataType));
KVVELDRA_WB_LAYOUT(offsetof(WBValue2, value) == offsetof(WBValue, value));
KVVELDRA_WB_LAYOUT(offsetof(WBValue2, timestamp) == offsetof(WBValue, timestamp));
KVVELDRA_WB_LAYOUT(sizeof(WBValue2) == sizeof(WBValue));
KVVELDRA_WB_LAYOUT(offsetof(WBAggregates, max) == 8);
KVVELDRA_WB_LAYOUT(offsetof(WBAggregates, min) == 16);
KVVELDRA_WB_LAYOUT(offsetof(WBAggregates, avg) == 24);
KVVELDRA_WB_LAYOUT(sizeof(WBAggregates) == 32);
KVVELDRA_WB_LAYOUT(offsetof(WBAggregates2, max) == KVVELDRA_WB_PICK(4, 8));
KVVELDRA_WB_LAYOUT(offsetof(WBAggregates2, min) == KVVELDRA_WB_PICK(8, 16));
KVVELDRA_WB_LAYOUT(offsetof(WBAggregates2, avg) == KVVELDRA_WB_PICK(16, 24));
KVVELDRA_WB_LAYOUT(offsetof(WBStrArray, elt) == KVVELDRA_WB_PICK(4, 8));
KVVELDRA_WB_LAYOUT(offsetof(WBPropertyArray, elt) == KVVELDRA_WB_PICK(4, 8));
KVVELDRA_WB_LAYOUT(offsetof(WBReferenceArray, elt) == 4);
KVVELDRA_WB_LAYOUT(offsetof(WBTypeArray, elt) == 4);
KVVELDRA_WB_LAYOUT(offsetof(WBTimestampArray, elt) == 8);
KVVELDRA_WB_LAYOUT(offsetof(WBVariantArray, elt) == KVVELDRA_WB_PICK(4, 8));
KVVELDRA_WB_LAYOUT(offsetof(WBValueArray, elt) == 8);
KVVELDRA_WB_LAYOUT(offsetof(WBValueArray2, elt) == 8);
#undef KVVELDRA_WB_PICK
#endif

#ifdef __cplusplus
}
#endif

#endif
