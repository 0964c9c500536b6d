// The texts of the phone's own applications: what their sources ask for, every language has.
#include <glib.h>
#include <gtest/gtest.h>
#include <libintl.h>

#include <array>
#include <clocale>
#include <cstdlib>
#include <cstring>
#include <filesystem>
#include <string>
#include <vector>

extern "C" int _nl_msg_cat_cntr;  // gettext's own: counts up when its answers may have changed

namespace fs = std::filesystem;

namespace {

constexpr std::array kApplications{"com.orlant.myfile-download-manager", "com.orlant.zelqo-history",
                                   "com.orlant.ovuport", "contacts-tabui-efl"};
constexpr std::array kLanguages{"en", "de", "fr",    "es", "pt", "ru",
                                "ko", "ja", "zh_CN", "ar", "he", "hi"};

testing::AssertionResult runs(std::vector<std::string> words) {
  std::vector<char*> argv;
  argv.reserve(words.size() + 1);
  for (auto& word : words) argv.push_back(word.data());
  argv.push_back(nullptr);
  char* said = nullptr;
  int status = -1;
  g_spawn_sync(nullptr, argv.data(), nullptr, G_SPAWN_SEARCH_PATH, nullptr, nullptr, nullptr, &said,
               &status, nullptr);
  const std::string complaint = said ? said : "";
  g_free(said);
  if (status == 0) return testing::AssertionSuccess();
  return testing::AssertionFailure() << words[0] << ": " << complaint;
}

void addSources(const fs::path& folder, std::vector<std::string>* words) {
  for (const auto& file : fs::directory_iterator(folder)) {
    if (file.path().extension() == ".cpp") words->push_back(file.path());
  }
}

/// Everything that the application asks its catalogue for.
testing::AssertionResult collectTexts(const std::string& application, const std::string& file) {
  std::vector<std::string> words{XGETTEXT,         "--language=C++",   "--from-code=UTF-8", "-k",
                                 "--keyword=text", "--keyword=format", "--output=" + file};
  addSources(fs::path(APPS_DIR) / "common/src", &words);
  addSources(fs::path(APPS_DIR) / application / "src", &words);
  return runs(words);
}

class CompanionCatalogue : public testing::TestWithParam<const char*> {};

TEST_P(CompanionCatalogue, HasEveryTextInEveryLanguage) {
  const std::string application = GetParam();
  const std::string texts = testing::TempDir() + application + ".pot";
  ASSERT_TRUE(collectTexts(application, texts));
  for (const char* language : kLanguages) {
    const std::string catalogue =
        std::string(APPS_BUILD_DIR "/").append(application).append("/").append(application);
    EXPECT_TRUE(runs({MSGCMP, catalogue + "." + language + ".po", texts})) << language;
  }
  fs::remove(texts);
}

TEST_P(CompanionCatalogue, LiesWhereTheApplicationLooks) {
  ASSERT_TRUE(setlocale(LC_ALL, "C.UTF-8"));
  const std::string folder = std::string(IMAGE_DIR "/apps/") + GetParam() + "/res/locale";
  bindtextdomain(GetParam(), folder.c_str());
  bind_textdomain_codeset(GetParam(), "UTF-8");
  for (const char* language : kLanguages) {
    setenv("LANGUAGE", language, 1);
    ++_nl_msg_cat_cntr;
    const std::string header = dgettext(GetParam(), "");
    EXPECT_NE(header.find(std::string("Language: ") + language + "\n"), std::string::npos)
        << header;
    const bool isEnglish = std::strcmp(language, "en") == 0;
    EXPECT_EQ(std::strcmp(dgettext(GetParam(), "Back"), "Back") == 0, isEnglish) << language;
  }
}

INSTANTIATE_TEST_SUITE_P(Applications, CompanionCatalogue, testing::ValuesIn(kApplications),
                         [](const auto& info) {
                           std::string name = info.param;
                           for (char& c : name) c = g_ascii_isalnum(c) ? c : '_';
                           return name;
                         });

}  // namespace
