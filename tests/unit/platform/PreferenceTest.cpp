#include "TestPhone.h"

#include <app_preference.h>
#include <appfw/PreferenceStore.h>
#include <glib.h>
#include <sqlite3.h>
#include <sys/wait.h>
#include <unistd.h>

#include <filesystem>
#include <functional>
#include <vector>

using appfw::PreferenceStore;

namespace {

std::string fileOf(const std::string& appId) {
  return TestPhone::root() + "/apps/" + appId + "/data/.pref.db";
}

std::string get(const char* key) {
  char* value = nullptr;
  preference_get_string(key, &value);
  return take(value);
}

class Preferences : public testing::Test {
 protected:
  Preferences() { preference_remove_all(); }
};

/// Runs the code in a process of its own; its result is the exit status.
template <typename Code>
pid_t inProcess(Code code) {
  const pid_t child = fork();
  if (child == 0) _exit(code());
  return child;
}

int exitStatus(pid_t child) {
  int status = -1;
  waitpid(child, &status, 0);
  return WIFEXITED(status) ? WEXITSTATUS(status) : -1;
}

std::string textOf(PreferenceStore& store, const std::string& key) {
  std::string text;
  store.getText(key, text);
  return text;
}

/// Runs the code in a callback of the main loop, with whatever was waiting for its next turn
/// before.
void inCallback(std::function<void()> code) {
  bool isDone = false;
  std::function<void()> both = [&] {
    code();
    isDone = true;
  };
  g_timeout_add(
      0,
      [](gpointer data) -> gboolean {
        (*static_cast<std::function<void()>*>(data))();
        return G_SOURCE_REMOVE;
      },
      &both);
  while (!isDone) g_main_context_iteration(nullptr, TRUE);
}

/// What one application reads while another connection writes.
class TurnsOfTheLoop : public testing::Test {
 protected:
  TurnsOfTheLoop() {
    EXPECT_EQ(other.removeAll(), PREFERENCE_ERROR_NONE);
    EXPECT_EQ(other.setText("k", "before"), PREFERENCE_ERROR_NONE);
  }
  void readAndLetItChange() {
    EXPECT_EQ(textOf(store, "k"), "before");
    ASSERT_EQ(other.setText("k", "after"), PREFERENCE_ERROR_NONE);
  }

  PreferenceStore store{"com.example.turns"};
  PreferenceStore other{"com.example.turns"};
};

}  // namespace

TEST_F(Preferences, TakeAnyTextAsKey) {
  const char* keys[] = {"http://127.0.0.1:8080/share/abc/file/0?x=1&y=2#z",
                        "a/b/../c",
                        "' OR 1=1 --",
                        "%s%n",
                        " ",
                        "caf\xc3\xa9",
                        "not \xff utf-8",
                        "line\nbreak"};
  for (const char* key : keys) EXPECT_EQ(preference_set_string(key, key), PREFERENCE_ERROR_NONE);
  for (const char* key : keys) EXPECT_EQ(get(key), key);
}

TEST_F(Preferences, AreOverwritten) {
  preference_set_string("k", "first");
  preference_set_string("k", "");
  EXPECT_EQ(get("k"), "");
}

TEST_F(Preferences, SayWhenAKeyIsMissing) {
  char* value = const_cast<char*>("untouched");
  bool existing = true;
  EXPECT_EQ(preference_get_string("k", &value), PREFERENCE_ERROR_NO_KEY);
  EXPECT_EQ(value, nullptr);
  EXPECT_EQ(preference_is_existing("k", &existing), PREFERENCE_ERROR_NONE);
  EXPECT_FALSE(existing);
  EXPECT_EQ(preference_remove("k"), PREFERENCE_ERROR_NO_KEY);
}

TEST_F(Preferences, AreRemovedOneByOneAndAllAtOnce) {
  preference_set_string("a", "1");
  preference_set_string("b", "2");
  preference_set_string("c", "3");
  EXPECT_EQ(preference_remove("a"), PREFERENCE_ERROR_NONE);
  bool existing = true;
  preference_is_existing("a", &existing);
  EXPECT_FALSE(existing);
  EXPECT_EQ(get("b"), "2");
  EXPECT_EQ(preference_remove_all(), PREFERENCE_ERROR_NONE);
  EXPECT_EQ(get("b"), "(null)");
}

TEST_F(Preferences, RefuseMissingKeysAndOversizeValues) {
  const std::string large(PreferenceStore::kMaxBytes, 'x');
  EXPECT_EQ(preference_set_string(nullptr, "v"), PREFERENCE_ERROR_INVALID_PARAMETER);
  EXPECT_EQ(preference_set_string("", "v"), PREFERENCE_ERROR_INVALID_PARAMETER);
  EXPECT_EQ(preference_set_string("k", nullptr), PREFERENCE_ERROR_INVALID_PARAMETER);
  EXPECT_EQ(preference_set_string("k", (large + "x").c_str()), PREFERENCE_ERROR_INVALID_PARAMETER);
  EXPECT_EQ(preference_set_string("k", large.c_str()), PREFERENCE_ERROR_NONE);
  EXPECT_EQ(get("k").size(), large.size());
}

TEST_F(Preferences, AreListedAndMayChangeMeanwhile) {
  preference_set_string("b", "2");
  preference_set_string("a", "1");
  std::vector<std::string> keys;
  preference_foreach_item(
      [](const char* key, void* data) {
        static_cast<std::vector<std::string>*>(data)->push_back(key);
        preference_remove(key);
        return true;
      },
      &keys);
  EXPECT_EQ(keys, (std::vector<std::string>{"a", "b"}));
  EXPECT_EQ(get("a"), "(null)");
}

TEST_F(Preferences, StopListingWhenToldSo) {
  preference_set_string("a", "1");
  preference_set_string("b", "2");
  int count = 0;
  preference_foreach_item(
      [](const char*, void* data) {
        ++*static_cast<int*>(data);
        return false;
      },
      &count);
  EXPECT_EQ(count, 1);
}

TEST(PreferenceStores, LoseNothingWithManyWritersThatMakeTheFileTogether) {
  constexpr int writers = 6, each = 200;
  std::vector<pid_t> children;
  children.reserve(writers);
  for (int writer = 0; writer < writers; writer++) {
    children.push_back(inProcess([writer] {
      PreferenceStore store("test.crowd");
      for (int i = 0; i < each; i++) {
        if (store.setText(std::to_string(writer) + "/" + std::to_string(i), "v") != 0) return 1;
      }
      return 0;
    }));
  }
  for (const pid_t child : children) EXPECT_EQ(exitStatus(child), 0);
  std::vector<std::string> keys;
  EXPECT_EQ(PreferenceStore("test.crowd").keys(keys), PREFERENCE_ERROR_NONE);
  EXPECT_EQ(keys.size(), static_cast<size_t>(writers * each));
}

TEST(PreferenceStores, SeeAtOnceWhatAnotherProcessWrote) {
  PreferenceStore store("test.shared");
  std::string value;
  ASSERT_EQ(store.setText("k", "mine"), PREFERENCE_ERROR_NONE);
  ASSERT_EQ(store.getText("k", value), PREFERENCE_ERROR_NONE);
  EXPECT_EQ(
      exitStatus(inProcess([] { return PreferenceStore("test.shared").setText("k", "its"); })), 0);
  EXPECT_EQ(store.getText("k", value), PREFERENCE_ERROR_NONE);
  EXPECT_EQ(value, "its");
}

TEST_F(TurnsOfTheLoop, AreAnsweredFromOneStateEach) {
  inCallback([this] {
    readAndLetItChange();
    EXPECT_EQ(textOf(store, "k"), "before");
  });
  inCallback([this] { EXPECT_EQ(textOf(store, "k"), "after"); });
}

TEST_F(TurnsOfTheLoop, SeeTheirOwnWrites) {
  inCallback([this] {
    readAndLetItChange();
    ASSERT_EQ(store.setText("l", "mine"), PREFERENCE_ERROR_NONE);
    EXPECT_EQ(textOf(store, "l"), "mine");
    EXPECT_EQ(textOf(store, "k"), "after");
  });
}

TEST_F(TurnsOfTheLoop, EndForWhomTheLoopDidNotCall) {
  inCallback([this] { readAndLetItChange(); });
  EXPECT_EQ(textOf(store, "k"), "after");
}

TEST_F(TurnsOfTheLoop, EndForWhoListsTheKeysToo) {
  inCallback([this] {
    readAndLetItChange();
    ASSERT_EQ(other.setText("l", "new"), PREFERENCE_ERROR_NONE);
  });
  std::vector<std::string> keys;
  EXPECT_EQ(store.keys(keys), PREFERENCE_ERROR_NONE);
  EXPECT_EQ(keys, (std::vector<std::string>{"k", "l"}));
}

TEST(PreferenceStores, MakeNoFileForReading) {
  PreferenceStore store("test.reader");
  std::string value;
  std::vector<std::string> keys;
  EXPECT_EQ(store.getText("k", value), PREFERENCE_ERROR_NO_KEY);
  EXPECT_EQ(store.remove("k"), PREFERENCE_ERROR_NO_KEY);
  EXPECT_EQ(store.keys(keys), PREFERENCE_ERROR_NONE);
  EXPECT_FALSE(std::filesystem::exists(TestPhone::root() + "/apps/test.reader"));
}

TEST(PreferenceStores, StartAnewWhenTheFileIsNoDatabase) {
  writeFile(fileOf("test.garbage"), std::string(20000, 'x'));
  PreferenceStore store("test.garbage");
  std::string value;
  EXPECT_EQ(store.getText("k", value), PREFERENCE_ERROR_NO_KEY);
  EXPECT_EQ(store.setText("k", "v"), PREFERENCE_ERROR_NONE);
  EXPECT_EQ(store.getText("k", value), PREFERENCE_ERROR_NONE);
  EXPECT_EQ(readFile(fileOf("test.garbage") + ".corrupt"), std::string(20000, 'x'));
}

TEST(PreferenceStores, StartAnewWhenTheFileWasDamagedInTheMiddle) {
  {
    PreferenceStore store("test.damaged");
    for (int i = 0; i < 500; i++) store.setText("key" + std::to_string(i), std::string(100, 'v'));
  }
  std::string bytes = readFile(fileOf("test.damaged"));
  ASSERT_GT(bytes.size(), 8192u);
  std::fill(bytes.begin() + 4096, bytes.end(), '\xee');
  writeFile(fileOf("test.damaged"), bytes);
  PreferenceStore store("test.damaged");
  std::string value;
  EXPECT_EQ(store.getText("key7", value), PREFERENCE_ERROR_NO_KEY);
  EXPECT_EQ(store.setText("key7", "new"), PREFERENCE_ERROR_NONE);
  EXPECT_EQ(store.getText("key7", value), PREFERENCE_ERROR_NONE);
  EXPECT_EQ(value, "new");
  EXPECT_TRUE(std::filesystem::exists(fileOf("test.damaged") + ".corrupt"));
}

TEST(PreferenceStores, AreNotReachedThroughATrickyApplicationId) {
  for (const char* id : {"", ".", "..", "../../etc", "a/b"}) {
    PreferenceStore store(id);
    EXPECT_EQ(store.setText("k", "v"), PREFERENCE_ERROR_IO_ERROR) << id;
  }
}

TEST(PreferenceStores, ReportAFolderThatCannotBeWritten) {
  writeFile(TestPhone::root() + "/apps/test.blocked/data", "a file where a folder should be");
  PreferenceStore store("test.blocked");
  EXPECT_EQ(store.setText("k", "v"), PREFERENCE_ERROR_IO_ERROR);
}
