// The build variant of an older library that lacks getLldp, for the
// binding's fallback: that one entry is missing, all others are there.
#include <dlfcn.h>
#include <gtest/gtest.h>
#include <string>
#include <vector>

#include "dtruj.h"

#define DTRUJ_NAME(name, cls) #name,
static const char* const entries[] = {DTRUJ_ENTRIES(DTRUJ_NAME)};

TEST(DtrujNoLldp, OnlyGetLldpIsMissing)
{
    void* h = dlopen("libdtruj.so", RTLD_NOW);
    ASSERT_NE(nullptr, h) << dlerror();
    std::vector<std::string> missing;
    for (const char* e : entries) {
        dlerror();
        dlsym(h, e);
        if (dlerror())
            missing.push_back(e);
    }
    EXPECT_EQ(std::vector<std::string>{"getLldp"}, missing);
}
