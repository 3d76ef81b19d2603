#include "cimhost/ProviderLibrary.h"

#include "cimhost/HostError.h"

#include <gmock/gmock.h>

#include <dlfcn.h>

#include <fstream>

namespace {

using cimhost::HostError;
using cimhost::ProviderLibrary;
using testing::HasSubstr;

std::string events() {
  const char* text = getenv("TEST_PROVIDER_EVENTS");
  return text != nullptr ? text : "";
}

bool isMapped(const char* file) {
  void* library = dlopen(file, RTLD_NOW | RTLD_NOLOAD);
  if (library != nullptr) dlclose(library);
  return library != nullptr;
}

class ProviderLibraryTest : public testing::Test {
 protected:
  void SetUp() override { unsetenv("TEST_PROVIDER_EVENTS"); }

  std::string loadError(const std::string& file, const std::string& provider) {
    try {
      library_.load(file, provider, handle_);
      return "loaded";
    } catch (const HostError& error) {
      EXPECT_FALSE(library_.isLoaded());
      EXPECT_FALSE(isMapped(file.c_str()));
      return error.what();
    }
  }

  Pegasus::CIMOMHandle handle_;
  ProviderLibrary library_;
};

TEST_F(ProviderLibraryTest, LoadsUsesAndUnloadsAgainAndAgain) {
  for (int round = 0; round < 2; ++round) {
    library_.load(TEST_PROVIDER_FILE, "CommonProvider", handle_);
    EXPECT_TRUE(library_.isLoaded());
    EXPECT_NE(library_.instances(), nullptr);
    EXPECT_NE(library_.associations(), nullptr);
    EXPECT_NE(library_.methods(), nullptr);
    library_.unload();
    EXPECT_EQ(library_.instances(), nullptr);
    EXPECT_EQ(library_.associations(), nullptr);
    EXPECT_EQ(library_.methods(), nullptr);
    EXPECT_FALSE(isMapped(TEST_PROVIDER_FILE));
  }
  EXPECT_EQ(events(), "create;initialize;terminate;create;initialize;terminate;");
}

TEST_F(ProviderLibraryTest, FailuresNameTheFileAndTheReason) {
  EXPECT_THAT(loadError("/no/such/library.so", "CommonProvider"),
              HasSubstr("cannot load the provider library: /no/such/library.so"));
  EXPECT_THAT(loadError(NO_PROVIDER_FILE, "CommonProvider"),
              HasSubstr("no entry point PegasusCreateProvider"));
  EXPECT_THAT(loadError(TEST_PROVIDER_FILE, "Unknown"), HasSubstr("no provider named Unknown"));
  EXPECT_THAT(loadError(TEST_PROVIDER_FILE, "ThrowsInCreate"), HasSubstr("no memory for you"));
  EXPECT_EQ(events(), "create;create;");
}

TEST_F(ProviderLibraryTest, AFailedInitializeIsTerminated) {
  EXPECT_THAT(loadError(TEST_PROVIDER_FILE, "ThrowsInInitialize"),
              HasSubstr("provider initialization failed: no luck"));
  EXPECT_THAT(loadError(TEST_PROVIDER_FILE, "ThrowsIntInInitialize"), HasSubstr("Unknown error."));
  EXPECT_EQ(events(), "create;initialize;terminate;create;initialize;terminate;");
}

TEST_F(ProviderLibraryTest, AFailedTerminateStillCloses) {
  library_.load(TEST_PROVIDER_FILE, "ThrowsInTerminate", handle_);
  EXPECT_THROW(library_.unload(), HostError);
  EXPECT_FALSE(isMapped(TEST_PROVIDER_FILE));
  library_.unload();
}

TEST(FindProviderLibrary, TheGivenFileBecomesAbsolute) {
  EXPECT_EQ(cimhost::findProviderLibrary("/a/b.so"), "/a/b.so");
  EXPECT_THAT(cimhost::findProviderLibrary("b.so"), testing::MatchesRegex("/.*/b\\.so"));
}

}  // namespace
