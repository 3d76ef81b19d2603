#pragma once

#include "cimhost/Sinks.h"

#include <memory>
#include <ostream>
#include <string>

namespace cimhost {

enum class OutputFormat { table, mof, json, xml };

/// Prints what an operation delivers. UTF-8 whatever the data; nothing is printed before the first
/// object or finish(). One result kind per writer.
class ResultWriter : public InstanceSink,
                     public ObjectPathSink,
                     public ClassSink,
                     public ClassNameSink,
                     public MethodResultSink {
 public:
  /// Ends the output; call it once. Not called when an operation failed before it delivered.
  virtual void finish() = 0;
};

/// `list` is several objects (a table with a row for each, a JSON array); `single` is one (a table
/// of its properties, a JSON object). A method's result is `single`. The stream must outlive the
/// writer; when it fails, the writer asks for no more.
enum class ResultForm { list, single };

std::unique_ptr<ResultWriter> makeTableWriter(std::ostream& out, ResultForm form);
std::unique_ptr<ResultWriter> makeMofWriter(std::ostream& out);
std::unique_ptr<ResultWriter> makeJsonWriter(std::ostream& out, ResultForm form);
/// An XML document with the elements of CIM-XML (DSP0201). `method`: the one whose result it will
/// be, or empty.
std::unique_ptr<ResultWriter> makeXmlWriter(std::ostream& out, const std::string& method);
std::unique_ptr<ResultWriter> makeResultWriter(OutputFormat format, std::ostream& out,
                                               ResultForm form, const std::string& method = "");

}  // namespace cimhost
