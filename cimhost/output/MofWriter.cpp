#include "cimhost/Text.h"
#include "cimhost/output/DisplayText.h"
#include "cimhost/output/MofText.h"
#include "cimhost/output/ResultWriter.h"

namespace cimhost {

namespace {

class MofWriter final : public ResultWriter {
 public:
  explicit MofWriter(std::ostream& out) : out_(out) {}

  bool deliverInstance(const Pegasus::CIMInstance& instance) override {
    return write(mofInstance(instance));
  }
  bool deliverClass(const Pegasus::CIMClass& declaration) override {
    return write(mofClass(declaration));
  }
  // Paths and names have no MOF declaration: one literal on each line.
  bool deliverPath(const Pegasus::CIMObjectPath& path) override {
    return static_cast<bool>(out_ << mofString(toUtf8(path.toString())) << '\n');
  }
  bool deliverClassName(const Pegasus::CIMName& name) override {
    return static_cast<bool>(out_ << toUtf8(name.getString()) << '\n');
  }
  // Nor has the result of a method: it stands as the properties of an instance would.
  bool deliverMethodResult(const Pegasus::CIMValue& returnValue,
                           const Pegasus::Array<Pegasus::CIMParamValue>& parameters) override {
    out_ << "ReturnValue = " << mofValue(returnValue) << ";\n";
    for (Pegasus::Uint32 i = 0; i < parameters.size(); ++i) {
      out_ << displayText(toUtf8(parameters[i].getParameterName())) << " = "
           << mofValue(parameters[i].getValue()) << ";\n";
    }
    return static_cast<bool>(out_);
  }
  void finish() override { out_.flush(); }

 private:
  bool write(const std::string& declaration) {
    if (!first_) out_ << '\n';
    first_ = false;
    return static_cast<bool>(out_ << declaration);
  }

  std::ostream& out_;
  bool first_ = true;
};

}  // namespace

std::unique_ptr<ResultWriter> makeMofWriter(std::ostream& out) {
  return std::make_unique<MofWriter>(out);
}

std::unique_ptr<ResultWriter> makeResultWriter(OutputFormat format, std::ostream& out,
                                               ResultForm form, const std::string& method) {
  switch (format) {
    case OutputFormat::mof:
      return makeMofWriter(out);
    case OutputFormat::json:
      return makeJsonWriter(out, form);
    case OutputFormat::xml:
      return makeXmlWriter(out, method);
    case OutputFormat::table:
      break;
  }
  return makeTableWriter(out, form);
}

}  // namespace cimhost
