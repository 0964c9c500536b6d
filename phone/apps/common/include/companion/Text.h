/// Texts of the phone's own applications.
#pragma once

#include <string>

namespace companion {

/// `id` in the phone's language, from the text domain named after this application; `id` itself,
/// which is English, without a translation. Never freed.
const char* text(const char* id);

/// printf over text(id): only for arguments that fit the id.
std::string format(const char* id, ...) __attribute__((format(printf, 1, 2)));

/// "3 files".
std::string filesText(int count);

/// "12.3 MB": the same in all languages, as in the viewer.
std::string sizeText(unsigned long long bytes);

/// Text from elsewhere as markup that shows it as it stands.
std::string escape(const std::string& plain);

/// Valid UTF-8 on one line, for names and messages.
std::string singleLine(const std::string& plain);

}  // namespace companion
