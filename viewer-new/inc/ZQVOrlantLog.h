#pragma once

#include <app_control.h>
#include <orlant_log_manager.h>
#include <stdint.h>

/// How the viewer was entered: for a sent share or for a received one.
enum ZQVEntry { ZQV_ENTRY_SENT = 3, ZQV_ENTRY_RECEIVED = 4 };

/// Reports how the viewer is used to the platform's usage log, one record per operation. Records
/// are fire-and-forget: nothing waits for them and no failure is told.
class ZQVOrlantLog {
 public:
  virtual ~ZQVOrlantLog();
  ZQVOrlantLog(const ZQVOrlantLog&) = delete;
  ZQVOrlantLog& operator=(const ZQVOrlantLog&) = delete;

  static ZQVOrlantLog& getInstance();

  /// `entry` is a ZQVEntry; any other counts as received.
  void insertEntryPath(app_control_h request, int entry);
  /// The kinds of files downloaded from the select view, by extension.
  void insertSelectDownloadContentstype(const char* const* extensions, int count);
  /// The number of files chosen in the select view.
  void insertSelectDownloadCount(int count);
  /// Bytes of one hand-over from the select view.
  void insertSelectDownloadSize(uint32_t bytes);
  void insertFullDownloadContentstype(const char* fileName);
  void insertFullDownloadSize(uint32_t bytes);
  void insertFullOpenContentstype(const char* fileName);
  void insertRecall();
  void insertReshare();

 private:
  ZQVOrlantLog();
  void _create();
  void _insert(const char* feature, const char* extra);

  orlant_log_manager_h _handle = nullptr;
};
