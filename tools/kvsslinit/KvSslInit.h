/* TLS start-up library of the platform, loaded at run time by name
 * ("libkvsslinit.so.13", RTLD_LAZY | RTLD_GLOBAL) and resolved with dlsym. */
#ifndef KVSSLINIT_KVSSLINIT_H
#define KVSSLINIT_KVSSLINIT_H

#ifdef __cplusplus
extern "C" {
#endif

#define KVSSLINIT_SONAME "libkvsslinit.so.13"

/* Starts OpenSSL. Returns a context for KVSSLINIT_Uninit, or null on failure. */
typedef void* (*KvSslInitFunction)(void);
/* Releases a context from KVSSLINIT_Init; null and unknown contexts are ignored. */
typedef void (*KvSslUninitFunction)(void* context);

void* KVSSLINIT_Init(void);
void KVSSLINIT_Uninit(void* context);

#ifdef __cplusplus
}
#endif

#endif
