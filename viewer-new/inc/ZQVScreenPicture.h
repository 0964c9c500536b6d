#pragma once

#include <Elementary.h>

#include <string>

#include "ZQVPicturePreload.h"

/// The picture of a page: what is seen first is decoded small, then, in the background, with as
/// many pixels as a page has.
class ZQVScreenPicture {
 public:
  enum class First {
    AtOnce,      ///< there with the first frame
    WhenDecoded  ///< decoded in the background, too; nothing waits for it
  };

  /// The prescale that a page's picture begins with, in pixels.
  static constexpr int kFirstSize = 480;

  /// `picture` is an image widget that shows `path` on a page of the pager, with the first
  /// prescale.
  static void follow(Evas_Object* picture, const char* path, Evas_Object* pager, First first);

  /// The prescale that a picture comes to on this pager's pages; 0 while they have no size.
  static int sizeOn(Evas_Object* pager, const char* path);

 private:
  ZQVScreenPicture(Evas_Object* picture, const char* path, Evas_Object* pager, First first);

  static void _resizedCb(void* data, Evas* canvas, Evas_Object* picture, void* info);
  static void _decodedCb(void* data, Evas* canvas, Evas_Object* image, void* info);
  static void _deletedCb(void* data, Evas* canvas, Evas_Object* picture, void* info);
  void _fit();
  void _showWhenDecoded();
  void _show();

  Evas_Object* _picture;
  Evas_Object* _pager;
  std::string _path;
  First _first;
  int _size = 0;
  bool _isSeen = false;
  bool _isWaiting = false;
  bool _isSharp = false;
  ZQVPicturePreload _preload;
};
