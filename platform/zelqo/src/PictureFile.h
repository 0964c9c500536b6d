/// A picture on its way into a folder: there under its final name when it is whole, not before.
#pragma once

#include <cstddef>
#include <string>

namespace zelqo {

class PictureFile {
 public:
  /// The names come from a hash of the address, never from the address itself.
  PictureFile(std::string folder, const std::string& url);
  /// What is not complete is removed.
  ~PictureFile();
  PictureFile(const PictureFile&) = delete;
  PictureFile& operator=(const PictureFile&) = delete;

  /// False when it cannot be written.
  bool write(const char* data, std::size_t size);
  enum class Result { Whole, NoPicture, Failed };
  /// Puts the file under path().
  Result finish();
  const std::string& path() const { return _path; }

  /// Removes what processes that ended in the middle have left in the folder.
  static void removeLeftovers(const std::string& folder);

 private:
  std::string _folder;
  std::string _hash;
  std::string _part;
  std::string _path;
  std::string _head;
  int _fd;
};

}  // namespace zelqo
