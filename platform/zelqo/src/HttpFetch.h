/// One HTTP request on the main loop of its thread, bounded in time and size.
#pragma once

#include <libsoup/soup.h>

#include <common/Owned.h>

#include <functional>
#include <memory>
#include <string>

#include "Loop.h"
#include "zelqo.h"

namespace zelqo {

using SessionOwner = common::Owned<SoupSession, g_object_unref>;
using MessageOwner = common::Owned<SoupMessage, g_object_unref>;

/// At most `connections` at a time; `inactivityS` without a byte ends a request.
SessionOwner makeSession(int connections, guint inactivityS);
/// Null for what is not the address of a web server.
MessageOwner makeMessage(const char* method, const std::string& url);

class HttpFetch {
 public:
  struct Limits {
    goffset size = 8 << 20;  ///< of the body
    guint deadlineMs = 60000;
  };
  struct Outcome {
    zelqo_error_e error = ZELQO_ERROR_NONE;  ///< of the transport, or for a status from 400 on
    guint status = 0;                        ///< 0 when there was no answer
    std::string reason;                      ///< for the log
    bool transient() const { return error == ZELQO_ERROR_NETWORK; }
  };
  /// Takes a piece of the body, of whatever status; false ends the request.
  using Sink = std::function<bool(guint status, const char* data, gsize size)>;
  /// Once, never from within the constructor; may destroy the request.
  using Done = std::function<void(const Outcome&)>;

  HttpFetch(SoupSession* session, MessageOwner message, Limits limits, Sink sink, Done done);
  /// Ends the request without a word.
  ~HttpFetch();
  HttpFetch(const HttpFetch&) = delete;
  HttpFetch& operator=(const HttpFetch&) = delete;

  SoupMessage* message() const { return _message.get(); }

 private:
  /// What a pending call is given: it may end when the request is long gone.
  struct Loan {
    HttpFetch* fetch;  ///< null then
    std::unique_ptr<char[]> piece;
  };
  static HttpFetch* claim(gpointer data);
  gpointer lend() const { return new std::shared_ptr<Loan>(_loan); }

  static void sentCb(GObject* session, GAsyncResult* result, gpointer data);
  static void readCb(GObject* stream, GAsyncResult* result, gpointer data);
  static gboolean deadlineCb(gpointer self);
  void readMore();
  void take(gsize size);
  void finish(zelqo_error_e error, const std::string& reason);
  zelqo_error_e statusError() const;

  MessageOwner _message;
  Limits _limits;
  Sink _sink;
  Done _done;
  std::shared_ptr<Loan> _loan;
  common::Owned<GCancellable, g_object_unref> _cancellable;
  common::Owned<GInputStream, g_object_unref> _stream;
  goffset _received = 0;
  SourceOwner _deadline;
};

}  // namespace zelqo
