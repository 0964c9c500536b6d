#include "Journey.h"

using phone::thePhone;
using phone::Words;

namespace {

constexpr const char* kFriend = "+821011112222";
constexpr const char* kOwnNumber = "+821012345678";

Words files() {
  return {thePhone().makeFile("File 1.txt"), thePhone().makeFile("File 2.txt"),
          thePhone().makeFile("File 3.txt")};
}

}  // namespace

Journey::Journey()
    : _received(thePhone().share(files())),
      _sent(thePhone().shareTo(kFriend, kOwnNumber, files())) {}

bool Journey::go(LoopWatch& watch) const {
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
  return launch("view_type=received contents_token=" + _received.token) &&
         touch({kFirstCell, kBottomButton}) && back() &&
         touch({kBottomButton, kSelectAll, kDone}) &&
         launch("view_type=sent request_id=" + std::to_string(_sent.request)) &&
         touch({kRecall, kCancel, kReshare}) && back();
}
