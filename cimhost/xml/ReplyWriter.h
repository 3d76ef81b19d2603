#pragma once

#include "cimhost/OperationStatus.h"
#include "cimhost/output/XmlBuffer.h"
#include "cimhost/xml/CimMessage.h"
#include "cimhost/xml/CimXmlService.h"
#include "cimhost/xml/HttpError.h"

#include <cstddef>
#include <string>

namespace cimhost {

/// Writes the reply to one message while results arrive, in pieces of about 64 KiB.
///
/// Nothing is sent before the first piece is full or the operation has ended, so that a failure
/// until then is a clean ERROR; after that it cuts the reply off. For one request, on one thread.
class ReplyWriter {
 public:
  static constexpr std::size_t kPiece = 65536;

  /// Both must outlive the writer.
  ReplyWriter(ReplyStream& stream, const CimMessage& message);

  /// IRETURNVALUE stands around the results, even when there are none. Before the first result.
  void wrapResults() { wrapped_ = true; }

  /// The place for the next result; call written() after each.
  XmlBuffer& next();
  /// False when nobody reads any more.
  bool written();
  /// The operation has ended. Call it once.
  void finish(const OperationStatus& status);

  std::size_t objects() const { return objects_; }

 private:
  void appendHead();
  void appendTail();
  void send();

  ReplyStream& stream_;
  const CimMessage& message_;
  bool wrapped_ = false;
  XmlBuffer buffer_;
  std::size_t objects_ = 0;
  bool begun_ = false;
  bool reading_ = true;
};

/// The reply to a request that is refused before any operation runs.
void refuse(ReplyStream& stream, const HttpError& error);

}  // namespace cimhost
