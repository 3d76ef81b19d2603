#pragma once

#include "cimhost/Operations.h"

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace cimhost {

/// The parts of an HTTP request that DSP0200 gives a meaning to.
class CimXmlRequest {
 public:
  virtual ~CimXmlRequest() = default;
  /// The value of a header, or nullopt when it is absent. Names are CIMOperation, CIMMethod,
  /// CIMObject, CIMProtocolVersion, CIMBatch, in this spelling: the transport has removed the
  /// number that M-POST puts before them and ignores their case.
  virtual std::optional<std::string> header(std::string_view name) const = 0;
  virtual std::string_view body() const = 0;
  /// Who asks, for the provider's context; empty when nobody is known.
  virtual std::string_view user() const = 0;
};

using HttpHeaders = std::vector<std::pair<std::string, std::string>>;

/// Where a reply goes, on the thread that calls CimXmlService::answer.
class ReplyStream {
 public:
  virtual ~ReplyStream() = default;
  /// Called once, before any write(): the HTTP status and the headers beyond those of the
  /// transport.
  virtual void begin(int httpStatus, const HttpHeaders& headers) = 0;
  /// Appends to the body. May wait until the client has taken earlier bytes. False: nobody reads
  /// any more, or the reply has been cut; nothing else needs to be written.
  virtual bool write(std::string_view bytes) = 0;
  /// The reply cannot be completed as begun (an operation failed after a part of its results had
  /// been sent): the client must see that it is cut off.
  virtual void abort() = 0;
};

/// What a request was about and how it ended, for the request log.
struct RequestSummary {
  std::string operation;  ///< For example EnumerateInstances, or the method's name; may be empty.
  std::string target;     ///< Namespace and class, for example root/host:Host_FileSystem.
  int httpStatus = 0;
  int cimStatus = 0;        ///< 0 when the operation succeeded or none was run.
  std::size_t objects = 0;  ///< Objects in the reply.
};

/// Answers CIM operations in XML (DSP0200, DSP0201) over any transport that carries HTTP messages.
///
/// Checks the CIM headers, reads the request, runs it on Operations and writes the reply while
/// results are delivered. Never throws; may be called from several threads at once.
class CimXmlService {
 public:
  /// Both must outlive this object.
  CimXmlService(const Operations& operations, const ClassRepository& repository);

  RequestSummary answer(const CimXmlRequest& request, ReplyStream& reply) const;

 private:
  const Operations& operations_;
  const ClassRepository& repository_;
};

}  // namespace cimhost
