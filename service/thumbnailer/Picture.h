/// Decoded pictures and the sizes in which the service offers them.
#pragma once

#include <gdk-pixbuf/gdk-pixbuf.h>

#include <memory>
#include <string>

namespace thumbnailer {

struct Unref {
  void operator()(GdkPixbuf* pixbuf) const { g_object_unref(pixbuf); }
};
using Picture = std::unique_ptr<GdkPixbuf, Unref>;

constexpr int kThumbPx = 320;
constexpr int kMidPx = 1280;
constexpr int kBigPx = 1600;

/// The picture upright and at most kBigPx long; null when it is none, or too large to be decoded by
/// what its header says.
Picture loadPicture(const std::string& path);

/// One frame of the video, upright; null when there is none.
Picture loadVideoFrame(const std::string& path);

/// Writes a JPEG whose longer side is at most `longest`, never an enlarged one; whole or not at
/// all.
bool savePicture(GdkPixbuf* picture, int longest, const std::string& path);

}  // namespace thumbnailer
