#include <Pegasus/Common/ResponseHandler.h>

PEGASUS_NAMESPACE_BEGIN

ResponseHandler::ResponseHandler() = default;
ResponseHandler::ResponseHandler(const ResponseHandler& handler) = default;
ResponseHandler& ResponseHandler::operator=(const ResponseHandler& handler) = default;
ResponseHandler::~ResponseHandler() = default;

void ResponseHandler::setContext(const OperationContext& context) {
  context_ = context;
}

OperationContext ResponseHandler::getContext() const {
  return context_;
}

InstanceResponseHandler::InstanceResponseHandler() = default;
InstanceResponseHandler::InstanceResponseHandler(const InstanceResponseHandler& handler) = default;
InstanceResponseHandler& InstanceResponseHandler::operator=(
    const InstanceResponseHandler& handler) = default;
InstanceResponseHandler::~InstanceResponseHandler() = default;

ObjectPathResponseHandler::ObjectPathResponseHandler() = default;
ObjectPathResponseHandler::ObjectPathResponseHandler(const ObjectPathResponseHandler& handler) =
    default;
ObjectPathResponseHandler& ObjectPathResponseHandler::operator=(
    const ObjectPathResponseHandler& handler) = default;
ObjectPathResponseHandler::~ObjectPathResponseHandler() = default;

ObjectResponseHandler::ObjectResponseHandler() = default;
ObjectResponseHandler::ObjectResponseHandler(const ObjectResponseHandler& handler) = default;
ObjectResponseHandler& ObjectResponseHandler::operator=(const ObjectResponseHandler& handler) =
    default;
ObjectResponseHandler::~ObjectResponseHandler() = default;

MethodResultResponseHandler::MethodResultResponseHandler() = default;
MethodResultResponseHandler::MethodResultResponseHandler(
    const MethodResultResponseHandler& handler) = default;
MethodResultResponseHandler& MethodResultResponseHandler::operator=(
    const MethodResultResponseHandler& handler) = default;
MethodResultResponseHandler::~MethodResultResponseHandler() = default;

PEGASUS_NAMESPACE_END
