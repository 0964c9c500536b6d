#pragma once

/// Every picture file passes here before the canvas gets it: a header of a few bytes can make the
/// image loaders spend gigabytes or crash.
class ZQVPictureGate {
 public:
  enum Use {
    Thumbnail,  ///< a small cell: the whole file must be small, too
    FullView    ///< large JPEG pictures are allowed, they are decoded at a reduced size
  };

  /// Only the header of the file is read. A refusal is logged with its reason; a file that does not
  /// exist and a null path are refused silently.
  static bool passes(const char* path, Use use);

  /// What decoding a picture is like; nothing of it for what is none.
  struct Decoding {
    bool isReducible = false;  ///< its loader can decode it at a fraction of its size
    bool isSlow = false;       ///< for a small cell it takes longer than a frame may
  };
  static Decoding decodingOf(const char* path);
  /// May it be decoded before anybody asks to see it in full view? Nothing is logged.
  static bool isLight(const char* path);
};
