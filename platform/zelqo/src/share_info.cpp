// The calls that answer from the store.
#include <base/Fault.h>

#include <cstring>
#include <limits>

#include "ShareBook.h"
#include "zelqo.h"

using zelqo::ReceivedFile;
using zelqo::ReceivedHandle;
using zelqo::SentHandle;
using zelqo::ShareBook;

namespace {

ReceivedHandle* received(zelqo_share_h handle) {
  return ShareBook::instance().received(handle);
}

SentHandle* sent(zelqo_share_h handle) {
  return ShareBook::instance().sent(handle);
}

int giveText(const std::optional<std::string>& text, char** out) {
  if (!text || text->empty()) return ZELQO_ERROR_NO_DATA;
  *out = strdup(text->c_str());
  return *out ? ZELQO_ERROR_NONE : ZELQO_ERROR_OUT_OF_MEMORY;
}

using Text = std::optional<std::string> ReceivedFile::*;

int giveFileText(zelqo_share_h handle, unsigned int index, Text member, bool isAddress,
                 char** out) {
  if (!out) return ZELQO_ERROR_INVALID_PARAMETER;
  *out = nullptr;
  ReceivedHandle* share = received(handle);
  if (!share) return ZELQO_ERROR_INVALID_PARAMETER;
  const ReceivedFile* file = ShareBook::instance().file(*share, index);
  if (!file) return ZELQO_ERROR_INVALID_PARAMETER;
  return giveText(isAddress ? share->address(file->*member) : file->*member, out);
}

}  // namespace

int zelqo_push_info_get_handle(const char* contents_token, zelqo_share_h* handle) {
  if (base::strikes(__func__)) return ZELQO_ERROR_STORE;
  if (!handle) return ZELQO_ERROR_INVALID_PARAMETER;
  *handle = nullptr;
  if (!contents_token || !*contents_token) return ZELQO_ERROR_INVALID_PARAMETER;
  return ShareBook::instance().openReceived(contents_token, *handle);
}

int zelqo_push_info_get_sender_msisdn(zelqo_share_h handle, char** msisdn) {
  if (base::strikes(__func__)) return ZELQO_ERROR_NO_DATA;
  if (!msisdn) return ZELQO_ERROR_INVALID_PARAMETER;
  *msisdn = nullptr;
  const ReceivedHandle* share = received(handle);
  if (!share) return ZELQO_ERROR_INVALID_PARAMETER;
  if (!*share->sender()) return ZELQO_ERROR_NO_DATA;
  *msisdn = share->sender();
  return ZELQO_ERROR_NONE;
}

int zelqo_push_info_get_content_info_count(zelqo_share_h handle, unsigned int* count) {
  if (base::strikes(__func__)) return ZELQO_ERROR_NO_DATA;
  if (!count) return ZELQO_ERROR_INVALID_PARAMETER;
  *count = 0;
  const ReceivedHandle* share = received(handle);
  if (!share) return ZELQO_ERROR_INVALID_PARAMETER;
  *count = static_cast<unsigned int>(share->fileCount());
  return ZELQO_ERROR_NONE;
}

int zelqo_push_info_get_expired_time(zelqo_share_h handle, unsigned long long* expired_time) {
  if (base::strikes(__func__)) return ZELQO_ERROR_NO_DATA;
  if (!expired_time) return ZELQO_ERROR_INVALID_PARAMETER;
  *expired_time = 0;
  const ReceivedHandle* share = received(handle);
  if (!share) return ZELQO_ERROR_INVALID_PARAMETER;
  *expired_time = share->endMs() > 0 ? static_cast<unsigned long long>(share->endMs()) : 0;
  return ZELQO_ERROR_NONE;
}

int zelqo_content_info_get_file_size(zelqo_share_h handle, unsigned int index, unsigned int* size) {
  if (base::strikes(__func__)) return ZELQO_ERROR_NO_DATA;
  if (!size) return ZELQO_ERROR_INVALID_PARAMETER;
  *size = 0;
  ReceivedHandle* share = received(handle);
  if (!share) return ZELQO_ERROR_INVALID_PARAMETER;
  const ReceivedFile* file = ShareBook::instance().file(*share, index);
  if (!file) return ZELQO_ERROR_INVALID_PARAMETER;
  constexpr std::int64_t largest = std::numeric_limits<unsigned int>::max();
  if (!file->size || *file->size < 0) return ZELQO_ERROR_NO_DATA;
  *size = static_cast<unsigned int>(*file->size < largest ? *file->size : largest);
  return ZELQO_ERROR_NONE;
}

int zelqo_content_info_get_file_name(zelqo_share_h handle, unsigned int index, char** name) {
  if (base::strikes(__func__)) return ZELQO_ERROR_NO_DATA;
  return giveFileText(handle, index, &ReceivedFile::name, false, name);
}

int zelqo_content_info_get_content_type(zelqo_share_h handle, unsigned int index, char** type) {
  if (base::strikes(__func__)) return ZELQO_ERROR_NO_DATA;
  return giveFileText(handle, index, &ReceivedFile::type, false, type);
}

int zelqo_content_info_get_thumbnail_url(zelqo_share_h handle, unsigned int index, char** url) {
  if (base::strikes(__func__)) return ZELQO_ERROR_NO_DATA;
  return giveFileText(handle, index, &ReceivedFile::thumb, true, url);
}

int zelqo_content_info_get_mid_thumbnail_url(zelqo_share_h handle, unsigned int index, char** url) {
  if (base::strikes(__func__)) return ZELQO_ERROR_NO_DATA;
  return giveFileText(handle, index, &ReceivedFile::mid, true, url);
}

int zelqo_content_info_get_big_thumbnail_url(zelqo_share_h handle, unsigned int index, char** url) {
  if (base::strikes(__func__)) return ZELQO_ERROR_NO_DATA;
  return giveFileText(handle, index, &ReceivedFile::big, true, url);
}

int zelqo_content_info_get_download_url(zelqo_share_h handle, unsigned int index, char** url) {
  if (base::strikes(__func__)) return ZELQO_ERROR_NO_DATA;
  return giveFileText(handle, index, &ReceivedFile::url, true, url);
}

int zelqo_upload_info_get_handle(int request_id, zelqo_share_h* handle) {
  if (base::strikes(__func__)) return ZELQO_ERROR_STORE;
  if (!handle) return ZELQO_ERROR_INVALID_PARAMETER;
  *handle = nullptr;
  return ShareBook::instance().openSent(request_id, *handle);
}

int zelqo_upload_info_get_recipient_msisdn_list(zelqo_share_h handle, zelqo_recipient_s*** list,
                                                unsigned int* count) {
  if (base::strikes(__func__)) return ZELQO_ERROR_NO_DATA;
  if (list) *list = nullptr;
  if (count) *count = 0;
  SentHandle* share = list && count ? sent(handle) : nullptr;
  if (!share) return ZELQO_ERROR_INVALID_PARAMETER;
  *list = share->recipients();
  *count = static_cast<unsigned int>(share->recipientCount());
  return ZELQO_ERROR_NONE;
}

int zelqo_upload_info_get_content_info_count(zelqo_share_h handle, unsigned int* count) {
  if (base::strikes(__func__)) return ZELQO_ERROR_NO_DATA;
  if (!count) return ZELQO_ERROR_INVALID_PARAMETER;
  *count = 0;
  const SentHandle* share = sent(handle);
  if (!share) return ZELQO_ERROR_INVALID_PARAMETER;
  *count = static_cast<unsigned int>(share->paths().size());
  return ZELQO_ERROR_NONE;
}

int zelqo_upload_info_get_content_file_path(zelqo_share_h handle, unsigned int index, char** path) {
  if (base::strikes(__func__)) return ZELQO_ERROR_NO_DATA;
  if (!path) return ZELQO_ERROR_INVALID_PARAMETER;
  *path = nullptr;
  const SentHandle* share = sent(handle);
  if (!share || index >= share->paths().size()) return ZELQO_ERROR_INVALID_PARAMETER;
  return giveText(share->paths()[index], path);
}
