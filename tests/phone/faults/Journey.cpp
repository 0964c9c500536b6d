#include "Journey.h"

#include <filesystem>
#include <fstream>

#include "Picture.h"
#include "ViewerSetting.h"

namespace fs = std::filesystem;
using phone::makePicture;
using phone::thePhone;
using phone::Words;

namespace {

constexpr const char* kFriend = "+821011112222";
constexpr const char* kOwnNumber = "+821012345678";

/// A text that can be opened, and pictures that have thumbnails.
Words files() {
  const std::string text = thePhone().makeFile("File 1.txt", 0);
  std::ofstream(text) << "A text that a program for texts opens.\n";
  return {text, makePicture(thePhone(), "File 2.jpg", phone::kRed),
          makePicture(thePhone(), "File 3.jpg", phone::kBlue)};
}

}  // namespace

Journey::Journey()
    : _received(thePhone().share(files())),
      _sent(thePhone().shareTo(kFriend, kOwnNumber, files())),
      _editor(ViewerSetting::outside("share/applications/l3afpad.desktop")) {
  for (const auto& file : fs::directory_iterator(ViewerSetting::outside("media/Downloads"))) {
    fs::remove_all(file);
  }
  std::ofstream(_editor) << "[Desktop Entry]\nType=Application\nName=Nothing\nExec=true %f\n"
                            "MimeType=text/plain;\n";
}

Journey::~Journey() {
  fs::remove(_editor);
}

bool Journey::go(LoopWatch& watch, const std::function<bool()>& isEnough) const {
  using namespace place;
  const auto launch = [&](const std::string& extras) {
    watch.run(PROGRAMS "/phone-launch launch_viewer " + extras);
    return watch.rest() != "silent";
  };
  const auto touch = [&](const Words& places) {
    for (const std::string& place : places) {
      watch.tap(place);
      if (watch.rest() == "silent") return false;
    }
    return true;
  };
  const auto back = [&] {
    watch.key("Escape");
    return watch.rest() != "silent";
  };
  const std::function<bool()> ways[] = {
      [&] { return launch("view_type=received contents_token=" + _received.token); },
      [&] {
        return touch({kFirstCell, kDownload, kOpen}) && back();
      },
      [&] {
        return touch({kDownload, kSelectAll, kDone});
      },
      [&] { return launch("view_type=sent request_id=" + std::to_string(_sent.request)); },
      [&] { return touch({kReshare}) && back(); },
      [&] {
        return touch({kRecall, kOk});
      },
  };
  for (const auto& way : ways) {
    if (!way()) return false;
    if (isEnough && isEnough()) break;
  }
  return true;
}
