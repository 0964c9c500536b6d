/// The MIME type that a sender announces.
#pragma once

#include <string>

namespace zelqo {

/// By the file's name and, where that says nothing, its first bytes.
std::string fileType(const std::string& path);

}  // namespace zelqo
