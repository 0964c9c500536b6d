#include <gtest/gtest.h>
#include <media_content.h>
#include <sys/stat.h>
#include <sys/time.h>

#include <filesystem>
#include <vector>

#include "../platform/TestPhone.h"
#include "FakeThumbnailer.h"

namespace fs = std::filesystem;

namespace {

struct Found {
  std::string path;
  std::string thumbnail;
  std::string type;
  std::string name;
};

bool collectCb(media_info_h media, void* data) {
  Found found;
  char* text = nullptr;
  media_info_get_file_path(media, &text);
  found.path = take(text);
  media_info_get_thumbnail_path(media, &text);
  found.thumbnail = take(text);
  media_info_get_mime_type(media, &text);
  found.type = take(text);
  media_info_get_display_name(media, &text);
  found.name = take(text);
  static_cast<std::vector<Found>*>(data)->push_back(found);
  return true;
}

bool stopCb(media_info_h, void* count) {
  ++*static_cast<int*>(count);
  return false;
}

class TheMediaDatabase : public testing::Test {
 protected:
  TheMediaDatabase() {
    setenv("XDG_CACHE_HOME", (TestPhone::root() + "/cache").c_str(), 1);
    fs::create_directories(folder);
    media_content_connect();
    media_filter_create(&filter);
  }
  ~TheMediaDatabase() override {
    media_filter_destroy(filter);
    media_content_disconnect();
    settle();  // what this test queued does not travel with the next one's
    fs::remove_all(folder);
  }

  std::string file(const std::string& name) {
    writeFile(folder + "/" + name, "content");
    return folder + "/" + name;
  }

  int condition(const std::string& text) {
    return media_filter_set_condition(filter, text.c_str(), MEDIA_CONTENT_COLLATE_NOCASE);
  }

  static std::string quoted(std::string path) {
    for (std::size_t at = 0; (at = path.find('\'', at)) != std::string::npos; at += 2) {
      path.insert(at, 1, '\'');
    }
    return "MEDIA_PATH = '" + path + "'";
  }

  std::vector<Found> find(const std::string& path) {
    std::vector<Found> found;
    EXPECT_EQ(condition(quoted(path)), MEDIA_CONTENT_ERROR_NONE);
    EXPECT_EQ(media_info_foreach_media_from_db(filter, collectCb, &found),
              MEDIA_CONTENT_ERROR_NONE);
    return found;
  }

  // Where the desktop's thumbnailer would put it.
  static std::string makeThumbnail(const std::string& path) {
    const common::OwnedText uri(g_filename_to_uri(path.c_str(), nullptr, nullptr));
    const common::OwnedText hash(g_compute_checksum_for_string(G_CHECKSUM_MD5, uri.get(), -1));
    const std::string cache = std::string(g_get_user_cache_dir()) + "/thumbnails/x-large";
    fs::create_directories(cache);
    std::string thumbnail = cache + "/" + hash.get() + ".png";
    writeFile(thumbnail, "picture");
    return thumbnail;
  }

  static void setModified(const std::string& path, time_t seconds) {
    const timeval times[2] = {{seconds, 0}, {seconds, 0}};
    ASSERT_EQ(utimes(path.c_str(), times), 0);
  }

  const std::string folder = TestPhone::root() + "/media/Images";
  filter_h filter = nullptr;
};

}  // namespace

TEST_F(TheMediaDatabase, KnowsAFileByItsPath) {
  const auto found = find(file("a.jpg"));
  ASSERT_EQ(found.size(), 1u);
  EXPECT_EQ(found[0].path, folder + "/a.jpg");
  EXPECT_EQ(found[0].type, "image/jpeg");
  EXPECT_EQ(found[0].name, "a.jpg");
  EXPECT_EQ(found[0].thumbnail, "(null)");
}

TEST_F(TheMediaDatabase, UnderstandsEveryPathWhoseQuotesAreDoubled) {
  for (const char* name : {"it's.jpg", "'", "''a''.jpg", "100%s.jpg", "a\nb.jpg", "\"x\".jpg"}) {
    const auto found = find(file(name));
    ASSERT_EQ(found.size(), 1u) << name;
    EXPECT_EQ(found[0].name, name);
  }
}

TEST_F(TheMediaDatabase, RefusesAConditionOfAnyOtherForm) {
  for (const char* text :
       {"", "MEDIA_PATH", "MEDIA_PATH =", "MEDIA_PATH = '", "MEDIA_PATH = 'it's.jpg'",
        "MEDIA_PATH = 'a' OR 1=1", "MEDIA_PATH = a", "MEDIA_TYPE = 'a'", "MEDIA_PATH = 'a''"}) {
    EXPECT_EQ(condition(text), MEDIA_CONTENT_ERROR_INVALID_PARAMETER) << text;
  }
  EXPECT_EQ(condition("MEDIA_PATH='a'"), MEDIA_CONTENT_ERROR_NONE);
}

TEST_F(TheMediaDatabase, KnowsNothingButPlainFiles) {
  EXPECT_TRUE(find(folder).empty());
  EXPECT_TRUE(find(folder + "/missing.jpg").empty());
  EXPECT_TRUE(find("").empty());
  EXPECT_TRUE(find("/" + std::string(4096, 'x')).empty());
  ASSERT_EQ(mkfifo((folder + "/fifo.jpg").c_str(), 0644), 0);
  EXPECT_TRUE(find(folder + "/fifo.jpg").empty());
}

TEST_F(TheMediaDatabase, GivesTheThumbnailThatTheDesktopMade) {
  const std::string path = file("with.jpg");
  const std::string thumbnail = makeThumbnail(path);
  EXPECT_EQ(find(path).at(0).thumbnail, thumbnail);
}

TEST_F(TheMediaDatabase, GivesNoThumbnailOlderThanItsFile) {
  const std::string path = file("changed.jpg");
  setModified(makeThumbnail(path), 1000000000);
  EXPECT_EQ(find(path).at(0).thumbnail, "(null)");
}

TEST_F(TheMediaDatabase, AsksForMissingThumbnailsOnceAndTogether) {
  const FakeThumbnailer thumbnailer;
  const std::string photo = file("new photo.jpg");
  const std::string film = file("new.mp4");
  find(photo);
  find(film);
  find(photo);
  find(file("new.txt"));
  ASSERT_TRUE(waitUntil([&] { return thumbnailer.calls() > 0; }));
  find(photo);
  settle();
  EXPECT_EQ(thumbnailer.calls(), 1);
  ASSERT_EQ(thumbnailer.uris().size(), 2u);
  EXPECT_EQ(thumbnailer.uris()[0], "file://" + folder + "/new%20photo.jpg");
  EXPECT_EQ(thumbnailer.types(), (std::vector<std::string>{"image/jpeg", "video/mp4"}));
}

TEST_F(TheMediaDatabase, ListsTheMediaFolderWithoutAFilter) {
  file("a.jpg");
  fs::create_directories(folder + "/sub");
  file("sub/b.jpg");
  file(".hidden.jpg");
  std::vector<Found> found;
  EXPECT_EQ(media_info_foreach_media_from_db(nullptr, collectCb, &found), MEDIA_CONTENT_ERROR_NONE);
  EXPECT_EQ(found.size(), 2u);
}

TEST_F(TheMediaDatabase, StopsWhenTheCallbackWantsNoMore) {
  file("a.jpg");
  file("b.jpg");
  int count = 0;
  media_info_foreach_media_from_db(nullptr, stopCb, &count);
  EXPECT_EQ(count, 1);
}

TEST_F(TheMediaDatabase, GivesClonesThatOutliveTheConnection) {
  condition(quoted(file("a.jpg")));
  media_info_h clone = nullptr;
  media_info_foreach_media_from_db(
      filter,
      [](media_info_h media, void* copy) {
        media_info_clone(static_cast<media_info_h*>(copy), media);
        return true;
      },
      &clone);
  ASSERT_TRUE(clone);
  char* path = nullptr;
  EXPECT_EQ(media_info_get_file_path(clone, &path), MEDIA_CONTENT_ERROR_NONE);
  EXPECT_EQ(take(path), folder + "/a.jpg");
  EXPECT_EQ(media_info_destroy(clone), MEDIA_CONTENT_ERROR_NONE);
}

TEST_F(TheMediaDatabase, NeedsAConnection) {
  media_content_disconnect();
  std::vector<Found> found;
  EXPECT_EQ(media_info_foreach_media_from_db(nullptr, collectCb, &found),
            MEDIA_CONTENT_ERROR_DB_FAILED);
  EXPECT_EQ(media_content_disconnect(), MEDIA_CONTENT_ERROR_INVALID_OPERATION);
  media_content_connect();
}

TEST_F(TheMediaDatabase, RefusesMissingArguments) {
  char* text = nullptr;
  media_info_h media = nullptr;
  EXPECT_EQ(media_filter_create(nullptr), MEDIA_CONTENT_ERROR_INVALID_PARAMETER);
  EXPECT_EQ(media_filter_destroy(nullptr), MEDIA_CONTENT_ERROR_INVALID_PARAMETER);
  EXPECT_EQ(media_filter_set_condition(nullptr, "x", MEDIA_CONTENT_COLLATE_NOCASE),
            MEDIA_CONTENT_ERROR_INVALID_PARAMETER);
  EXPECT_EQ(media_filter_set_condition(filter, nullptr, MEDIA_CONTENT_COLLATE_NOCASE),
            MEDIA_CONTENT_ERROR_INVALID_PARAMETER);
  EXPECT_EQ(media_info_foreach_media_from_db(filter, nullptr, nullptr),
            MEDIA_CONTENT_ERROR_INVALID_PARAMETER);
  EXPECT_EQ(media_info_clone(&media, nullptr), MEDIA_CONTENT_ERROR_INVALID_PARAMETER);
  EXPECT_EQ(media_info_destroy(nullptr), MEDIA_CONTENT_ERROR_INVALID_PARAMETER);
  EXPECT_EQ(media_info_get_thumbnail_path(nullptr, &text), MEDIA_CONTENT_ERROR_INVALID_PARAMETER);
}
