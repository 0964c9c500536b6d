/// The viewer's log lines: source, function and line first, then the coloured message.
#pragma once

#include <dlog.h>

#define ZQV_LOG_TAG "ZQ_VIEWER"
#define ZQV_LOG(priority, open, fmt, ...)                                                         \
  dlog_print(priority, ZQV_LOG_TAG, "%s: %s(%d) > " open fmt "\033[0;m", __FILE_NAME__, __func__, \
             __LINE__, ##__VA_ARGS__)
#define ZQV_ERROR(fmt, ...) ZQV_LOG(DLOG_ERROR, "\033[0;31m* Critical * ", fmt, ##__VA_ARGS__)
#define ZQV_TRACE(fmt, ...) ZQV_LOG(DLOG_INFO, "\033[0;32m", fmt, ##__VA_ARGS__)
