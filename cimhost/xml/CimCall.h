#pragma once

#include "cimhost/xml/CimMessage.h"
#include "cimhost/xml/CimXmlService.h"
#include "cimhost/xml/ReplyWriter.h"

#include <Pegasus/Common/OperationContext.h>

#include <string>

namespace cimhost {

/// What an operation works on: one request, who asks, and where its results go.
struct CimCall {
  const Operations& operations;
  const ClassRepository& repository;
  const CimMessage& message;
  const Pegasus::OperationContext& context;
  Pegasus::CIMNamespaceName nameSpace;
  ReplyWriter& writer;
  std::string& subject;  ///< Set to the class, or what else the request is about; UTF-8.

  void isAbout(const Pegasus::CIMName& name) const;
};

/// Runs an operation of DSP0200. What Operations cannot be asked at all is thrown: HttpError or
/// Pegasus::CIMException.
OperationStatus runIntrinsic(const CimCall& call);

/// Runs a method of a class; throws in the same way.
OperationStatus runExtrinsic(const CimCall& call);

}  // namespace cimhost
