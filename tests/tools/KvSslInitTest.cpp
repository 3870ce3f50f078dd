#include <dlfcn.h>
#include <gtest/gtest.h>
#include <openssl/ssl.h>

#include <memory>

namespace {

struct LibraryCloser {
    void operator()(void* handle) const { dlclose(handle); }
};
using Library = std::unique_ptr<void, LibraryCloser>;

// The message bus finds the TLS start-up library by its name alone; from a
// test binary, as from libkvveldra_tag.so, the run path must lead to it.
Library OpenByName() {
    return Library(dlopen(KVVELDRA_SSLINIT_SONAME, RTLD_LAZY | RTLD_GLOBAL));
}

TEST(KvSslInit, LoadsByNameAndStartsOpenSsl) {
    Library library = OpenByName();
    ASSERT_NE(library, nullptr) << dlerror();
    auto init = reinterpret_cast<void* (*)()>(dlsym(library.get(), "KVSSLINIT_Init"));
    auto uninit = reinterpret_cast<void (*)(void*)>(dlsym(library.get(), "KVSSLINIT_Uninit"));
    ASSERT_NE(init, nullptr);
    ASSERT_NE(uninit, nullptr);

    void* first = init();
    void* second = init();
    ASSERT_NE(first, nullptr);
    ASSERT_NE(second, nullptr);
    SSL_CTX* context = SSL_CTX_new(TLS_client_method());
    EXPECT_NE(context, nullptr);
    SSL_CTX_free(context);

    uninit(second);
    uninit(first);
    // Releasing what it never handed out does nothing.
    int foreign = 0;
    uninit(&foreign);
    uninit(nullptr);
}

}  // namespace
