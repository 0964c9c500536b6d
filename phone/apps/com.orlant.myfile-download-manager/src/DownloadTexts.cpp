#include "DownloadTexts.h"

#include <companion/Text.h>

#include <cmath>

using companion::format;
using companion::sizeText;
using companion::text;

namespace downloads {
namespace {

const char* failureText(Failure failure) {
  switch (failure) {
    case Failure::Gone:
      return text("No longer available");
    case Failure::Refused:
      return text("The sharing service did not send the file");
    case Failure::Network:
      return text("Connection lost");
    case Failure::Silent:
      return text("The sharing service does not answer");
    case Failure::WrongSize:
      return text("The file does not have the announced size");
    case Failure::DiskFull:
      return text("Not enough space on the phone");
    case Failure::Storage:
      return text("The file cannot be stored");
    case Failure::Address:
      return text("Not an address to download from");
    case Failure::None:
      break;
  }
  return text("Failed");
}

std::string progressText(const Download& download) {
  if (download.size == 0) return sizeText(download.received);
  return format("%s of %s", sizeText(download.received).c_str(), sizeText(download.size).c_str());
}

std::string waitingText(const Download& download, bool isHeldBack) {
  if (!isHeldBack) return text("Waiting");
  return download.wifiOnly ? text("Waiting for Wi-Fi") : text("Waiting for a network");
}

}  // namespace

std::string detailOf(const Download& download, bool isHeldBack) {
  switch (download.state) {
    case State::Queued:
      return waitingText(download, isHeldBack);
    case State::Running:
      return progressText(download);
    case State::Done:
      return format("Downloaded, %s", sizeText(download.size).c_str());
    case State::Cancelled:
      return text("Cancelled");
    case State::Failed:
      break;
  }
  return failureText(download.failure);
}

std::string timeLeftText(std::optional<double> seconds) {
  if (!seconds) return {};
  const auto whole = static_cast<long>(std::ceil(*seconds));
  if (whole < 60) return format("%ld s left", whole);
  if (whole < 3600) return format("%ld min %ld s left", whole / 60, whole % 60);
  return format("%ld h %ld min left", whole / 3600, whole % 3600 / 60);
}

}  // namespace downloads
