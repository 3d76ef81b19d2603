#include "cimhost/ProviderLibrary.h"

#include "cimhost/HostError.h"

#include <gmock/gmock.h>

#include <dlfcn.h>

namespace {

using cimhost::HostError;
using cimhost::ProviderLibrary;
using testing::HasSubstr;

bool isMapped(const char* file) {
  void* library = dlopen(file, RTLD_NOW | RTLD_NOLOAD);
  if (library != nullptr) dlclose(library);
  return library != nullptr;
}

class ProviderLibraryTest : public testing::Test {
 protected:
  Pegasus::CIMOMHandle handle_;
  ProviderLibrary library_;
};

TEST_F(ProviderLibraryTest, LoadsAndUnloadsAgainAndAgain) {
  for (const char* name : {"CommonProvider", "ThrowsInTerminate", "CommonProvider"}) {
    library_.load(TEST_PROVIDER_FILE, name, handle_);
    EXPECT_TRUE(library_.isLoaded());
    if (name == std::string("ThrowsInTerminate")) {
      EXPECT_THROW(library_.unload(), HostError);
    }
    library_.unload();
    EXPECT_FALSE(library_.instances() || library_.associations() || library_.methods());
    EXPECT_FALSE(isMapped(TEST_PROVIDER_FILE));
  }
}

// What was initialized in vain is terminated.
TEST_F(ProviderLibraryTest, FailuresNameTheFileAndTheReason) {
  const struct {
    const char *file, *provider, *reason, *events;
  } cases[] = {
      {"/no/such/library.so", "CommonProvider",
       "cannot load the provider library: /no/such/library.so", ""},
      {NO_PROVIDER_FILE, "CommonProvider", "no entry point PegasusCreateProvider", ""},
      {TEST_PROVIDER_FILE, "Unknown", "no provider named Unknown", "create;"},
      {TEST_PROVIDER_FILE, "ThrowsInCreate", "no memory for you", "create;"},
      {TEST_PROVIDER_FILE, "ThrowsInInitialize", "provider initialization failed: no luck",
       "create;initialize;terminate;"},
      {TEST_PROVIDER_FILE, "ThrowsIntInInitialize", "Unknown error.",
       "create;initialize;terminate;"},
  };
  for (const auto& row : cases) {
    setenv("TEST_PROVIDER_EVENTS", "", 1);
    try {
      library_.load(row.file, row.provider, handle_);
      ADD_FAILURE() << row.provider;
    } catch (const HostError& error) {
      EXPECT_THAT(error.what(), HasSubstr(row.reason));
    }
    EXPECT_FALSE(library_.isLoaded());
    EXPECT_FALSE(isMapped(row.file));
    EXPECT_STREQ(getenv("TEST_PROVIDER_EVENTS"), row.events) << row.provider;
  }
}

TEST(FindProviderLibrary, TheGivenFileBecomesAbsolute) {
  EXPECT_EQ(cimhost::findProviderLibrary("/a/b.so"), "/a/b.so");
  EXPECT_THAT(cimhost::findProviderLibrary("b.so"), testing::MatchesRegex("/.*/b\\.so"));
}

}  // namespace
