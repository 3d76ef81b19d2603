#include "cimhost/xml/CimXmlService.h"

#include "cimhost/Text.h"
#include "cimhost/xml/CimCall.h"
#include "cimhost/xml/CimHeaders.h"
#include "cimhost/xml/HttpError.h"
#include "cimhost/xml/RequestValues.h"

namespace cimhost {

using namespace Pegasus;

namespace {

// Counts what is sent, to know whether a failure can still be told.
class WatchedStream final : public ReplyStream {
 public:
  explicit WatchedStream(ReplyStream& stream) : stream_(stream) {}

  void begin(int httpStatus, const HttpHeaders& headers) override {
    status_ = httpStatus;
    stream_.begin(httpStatus, headers);
  }
  bool write(std::string_view bytes) override { return stream_.write(bytes); }
  void abort() override { stream_.abort(); }

  int status() const { return status_; }

 private:
  ReplyStream& stream_;
  int status_ = 0;
};

CIMNamespaceName namespaceOf(const CimMessage& message) {
  const String text = fromUtf8(namespaceText(message.namespacePath()));
  try {
    return CIMNamespaceName(text);
  } catch (const Exception&) {
    throw CIMException(CIM_ERR_INVALID_NAMESPACE, text);
  }
}

// "root/cimv2:Class", or what of it is known.
std::string targetOf(const CimMessage& message, const std::string& subject) {
  const std::string nameSpace = namespaceText(message.namespacePath());
  return subject.empty() ? nameSpace : nameSpace + ":" + subject;
}

// An HttpError passes: it comes before anything is written.
template <class Call>
OperationStatus runCall(Call call) {
  try {
    return call();
  } catch (const HttpError&) {
    throw;
  } catch (...) {
    return currentExceptionStatus();
  }
}

void run(const Operations& operations, const ClassRepository& repository,
         const CimXmlRequest& request, ReplyStream& reply, RequestSummary& summary) {
  checkHeaders(request);
  const CimMessage message(request.body());
  summary.operation = message.method();
  summary.target = targetOf(message, "");
  compareHeaders(request, message);
  const OperationContext context = makeContext(std::string(request.user()));
  ReplyWriter writer(reply, message);
  std::string subject;
  const OperationStatus status = runCall([&] {
    const CimCall call{operations,           repository, message, context,
                       namespaceOf(message), writer,     subject};
    return message.isIntrinsic() ? runIntrinsic(call) : runExtrinsic(call);
  });
  summary.target = targetOf(message, subject);
  summary.cimStatus = static_cast<int>(status.code);
  writer.finish(status);
  summary.objects = writer.objects();
}

// No exception of a transport or of memory that has run out leaves the service.
void runGuarded(const Operations& operations, const ClassRepository& repository,
                const CimXmlRequest& request, WatchedStream& reply, RequestSummary& summary) {
  try {
    run(operations, repository, request, reply, summary);
  } catch (const HttpError& error) {
    refuse(reply, error);
  } catch (...) {
    summary.cimStatus = CIM_ERR_FAILED;
    if (reply.status() != 0) return reply.abort();
    refuse(reply, HttpError(500, nullptr, "the request could not be answered"));
  }
}

}  // namespace

void CimCall::isAbout(const CIMName& name) const {
  subject = toUtf8(name.getString());
}

CimXmlService::CimXmlService(const Operations& operations, const ClassRepository& repository)
    : operations_(operations), repository_(repository) {}

RequestSummary CimXmlService::answer(const CimXmlRequest& request, ReplyStream& reply) const {
  RequestSummary summary;
  WatchedStream watched(reply);
  try {
    runGuarded(operations_, repository_, request, watched, summary);
  } catch (...) {
    // The transport itself has failed.
  }
  summary.httpStatus = watched.status();
  return summary;
}

}  // namespace cimhost
