#include "KvSslInit.h"

#include <openssl/ssl.h>
#include <stdatomic.h>
#include <stdint.h>

#define KVSSLINIT_EXPORT __attribute__((visibility("default")))

/* One context serves every caller; it counts the starts that are not yet
 * released. OpenSSL itself is never torn down here: it cleans up at exit, and
 * tearing it down earlier would break other users in the process. */
typedef struct KvSslInitContext {
    atomic_int Starts;
} KvSslInitContext;

static KvSslInitContext context_;

KVSSLINIT_EXPORT void* KVSSLINIT_Init(void) {
    const uint64_t options = OPENSSL_INIT_LOAD_SSL_STRINGS | OPENSSL_INIT_LOAD_CRYPTO_STRINGS;
    if (OPENSSL_init_ssl(options, NULL) != 1) {
        return NULL;
    }
    atomic_fetch_add(&context_.Starts, 1);
    return &context_;
}

KVSSLINIT_EXPORT void KVSSLINIT_Uninit(void* context) {
    if (context != &context_) {
        return;
    }
    int starts = atomic_load(&context_.Starts);
    while (starts > 0 && !atomic_compare_exchange_weak(&context_.Starts, &starts, starts - 1)) {
    }
}
