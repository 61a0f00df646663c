#include "support/InChild.h"

#include <dlfcn.h>
#include <gtest/gtest.h>
#include <string>

// Does not link the logger: it is loaded and unloaded as an object manager does with a provider's libraries.

TEST(Unloading, ReallyHappensAndLeavesNothing) {
    const std::string result = support::inChild([] {
        setenv("NVLOG_SINK", "file:/dev/null", 1);
        const int before = dup(0);
        close(before);
        for (int i = 0; i < 3; ++i) {
            void* const library = dlopen(NVLOG_LIBRARY, RTLD_NOW);
            if (library == nullptr) return std::string(dlerror());
            const auto construct = reinterpret_cast<void (*)(void*)>(dlsym(library, "_ZN5NVLog15NVMessageBufferC1Ev"));
            const auto destroy = reinterpret_cast<void (*)(void*)>(dlsym(library, "_ZN5NVLog15NVMessageBufferD1Ev"));
            using Log =
                void (*)(const char*, const char*, int, const std::string&, int, char*, int, int, const std::string&);
            const auto log = reinterpret_cast<Log>(
                dlsym(library, "_ZN5NVLog8NVLogger15logLevelMessageEPKcS2_iRKNSt7__cxx1112basic_stringIcSt11char_"
                               "traitsIcESaIcEEEiPciiSA_"));
            if (construct == nullptr || destroy == nullptr || log == nullptr) return std::string("a symbol is missing");
            void* buffer = nullptr; // as large as the class, which is one pointer
            construct(&buffer);
            log("run", "UnloadTest", 1, "Norvane.Test", 6000, nullptr, 0, 0, "x");
            destroy(&buffer);
            dlclose(library);
            if (dlopen(NVLOG_LIBRARY, RTLD_NOW | RTLD_NOLOAD) != nullptr) return std::string("still loaded");
            if (support::inChild([] { return std::string("forked"); }) != "forked") return std::string("forks call it");
        }
        const int after = dup(0);
        close(after);
        return std::string(after == before ? "gone" : "a descriptor is left open");
    });
    EXPECT_EQ(result, "gone");
}
