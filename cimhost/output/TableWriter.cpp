#include "cimhost/Text.h"
#include "cimhost/output/DisplayText.h"
#include "cimhost/output/MofText.h"
#include "cimhost/output/ResultWriter.h"

#include <algorithm>
#include <map>
#include <string>
#include <vector>

namespace cimhost {

using namespace Pegasus;

namespace {

// A longer cell is cut (never the last of a line), so that one long text cannot widen every line.
constexpr std::size_t kMaximumWidth = 60;
// Rows whose widths are computed together: a larger result comes as several tables.
constexpr std::size_t kRowsPerTable = 1000;
constexpr std::size_t kColumnsPerTable = 1000;

using Row = std::vector<std::string>;

// Strings stand as they are, without quotes; the rest as in MOF.
std::string cellText(const CIMValue& value) {
  if (value.isNull()) return "";
  if (value.isArray() || value.getType() == CIMTYPE_CHAR16) return displayText(mofValue(value));
  switch (value.getType()) {
    case CIMTYPE_STRING: {
      String string;
      value.get(string);
      return displayText(toUtf8(string));
    }
    case CIMTYPE_DATETIME:
    case CIMTYPE_REFERENCE:
      return displayText(toUtf8(value.toString()));
    default:
      return displayText(mofValue(value));
  }
}

std::string nameText(const CIMName& name) {
  return displayText(toUtf8(name.getString()));
}

void printRow(std::ostream& out, const Row& row, const std::vector<std::size_t>& widths) {
  std::string line;
  for (std::size_t i = 0; i < row.size(); ++i) {
    const bool last = i + 1 == row.size();
    const std::string cell = last ? row[i] : fitToWidth(row[i], kMaximumWidth);
    line += cell;
    if (!last) line.append(widths[i] - displayWidth(cell) + 2, ' ');
  }
  line.erase(line.find_last_not_of(' ') + 1);
  out << line << '\n';
}

// All rows have the width of the header.
void printTable(std::ostream& out, const Row& header, const std::vector<Row>& rows) {
  std::vector<std::size_t> widths(header.size(), 0);
  const auto widen = [&widths](const Row& row) {
    for (std::size_t i = 0; i < row.size(); ++i) {
      widths[i] = std::max(widths[i], std::min(displayWidth(row[i]), kMaximumWidth));
    }
  };
  widen(header);
  std::for_each(rows.begin(), rows.end(), widen);
  Row rule;
  for (const std::size_t width : widths) rule.emplace_back(width, '-');
  printRow(out, header, widths);
  printRow(out, rule, widths);
  for (const Row& row : rows) printRow(out, row, widths);
}

// The instances of one table: a column for each property that any of them has, in order of
// appearance.
class InstanceTable {
 public:
  void add(const CIMInstance& instance) {
    classes_.push_back(nameText(instance.getClassName()));
    std::map<std::size_t, std::string> cells;
    for (Uint32 i = 0; i < instance.getPropertyCount(); ++i) {
      const CIMConstProperty property = instance.getProperty(i);
      cells[columnOf(property.getName())] = cellText(property.getValue());
    }
    rows_.push_back(std::move(cells));
  }

  bool isEmpty() const { return rows_.empty(); }
  bool isFull() const {
    return rows_.size() >= kRowsPerTable || columns_.size() >= kColumnsPerTable;
  }

  // The class is a column of its own only where the instances differ in it.
  void print(std::ostream& out) const {
    const bool mixed = std::any_of(classes_.begin(), classes_.end(),
                                   [this](const auto& name) { return name != classes_.front(); });
    Row header = columns_;
    std::vector<Row> rows;
    for (const auto& cells : rows_) {
      Row row(columns_.size());
      for (const auto& cell : cells) row[cell.first] = cell.second;
      if (mixed) row.insert(row.begin(), classes_[rows.size()]);
      rows.push_back(std::move(row));
    }
    if (mixed) header.insert(header.begin(), "(class)");
    printTable(out, header, rows);
  }

 private:
  std::size_t columnOf(const CIMName& property) {
    const std::string name = nameText(property);
    const auto known = index_.emplace(name, columns_.size());
    if (known.second) columns_.push_back(name);
    return known.first->second;
  }

  Row columns_;
  std::map<std::string, std::size_t> index_;
  std::vector<std::map<std::size_t, std::string>> rows_;
  std::vector<std::string> classes_;
};

class TableWriter final : public ResultWriter {
 public:
  TableWriter(std::ostream& out, ResultForm form)
      : out_(out), single_(form == ResultForm::single) {}

  bool deliverInstance(const CIMInstance& instance) override {
    if (single_) return printSingle(instance);
    table_.add(instance);
    if (table_.isFull()) printInstances();
    return static_cast<bool>(out_);
  }

  bool deliverPath(const CIMObjectPath& path) override {
    return printLine(displayText(toUtf8(path.toString())));
  }
  bool deliverClassName(const CIMName& name) override { return printLine(nameText(name)); }
  bool deliverClass(const CIMClass& declaration) override;
  bool deliverMethodResult(const CIMValue& returnValue,
                           const Array<CIMParamValue>& parameters) override {
    std::vector<Row> rows = {{"(return value)", cellText(returnValue)}};
    for (Uint32 i = 0; i < parameters.size(); ++i) {
      rows.push_back({displayText(toUtf8(parameters[i].getParameterName())),
                      cellText(parameters[i].getValue())});
    }
    printTable(out_, {"Parameter", "Value"}, rows);
    return static_cast<bool>(out_);
  }

  void finish() override {
    if (!table_.isEmpty()) printInstances();
    out_.flush();
  }

 private:
  bool printLine(const std::string& line) { return static_cast<bool>(out_ << line << '\n'); }

  void printInstances() {
    if (printed_) out_ << '\n';
    printed_ = true;
    table_.print(out_);
    table_ = InstanceTable();
  }

  bool printSingle(const CIMInstance& instance) {
    std::vector<Row> rows;
    for (Uint32 i = 0; i < instance.getPropertyCount(); ++i) {
      const CIMConstProperty property = instance.getProperty(i);
      rows.push_back({nameText(property.getName()), cellText(property.getValue())});
    }
    printLine(displayText(toUtf8(instance.getPath().toString())));
    printTable(out_, {"Property", "Value"}, rows);
    return static_cast<bool>(out_);
  }

  std::ostream& out_;
  bool single_;
  bool printed_ = false;
  InstanceTable table_;
};

template <class Element>
std::string typeText(const Element& element) {
  std::string type = cimTypeToString(element.getType());
  if (element.getType() == CIMTYPE_REFERENCE) {
    type = nameText(element.getReferenceClassName()) + " REF";
  }
  const std::string declared = mofDeclarator(type, "", element.isArray(), element.getArraySize());
  return declared.substr(0, type.size()) + declared.substr(type.size() + 1);
}

template <class Element>
bool hasTrueQualifier(const Element& element, const char* name) {
  const Uint32 position = element.findQualifier(CIMName(name));
  if (position == PEG_NOT_FOUND) return false;
  return element.getQualifier(position).getValue().equal(CIMValue(true));
}

std::string parametersText(const CIMConstMethod& method) {
  std::string text;
  for (Uint32 i = 0; i < method.getParameterCount(); ++i) {
    const CIMConstParameter parameter = method.getParameter(i);
    if (i > 0) text += ", ";
    if (hasTrueQualifier(parameter, "in")) text += "in ";
    if (hasTrueQualifier(parameter, "out")) text += "out ";
    text += typeText(parameter) + " " + nameText(parameter.getName());
  }
  return text;
}

bool TableWriter::deliverClass(const CIMClass& declaration) {
  const CIMConstClass object(declaration);
  std::string title = "class " + nameText(object.getClassName());
  if (!object.getSuperClassName().isNull()) title += " : " + nameText(object.getSuperClassName());
  if (printed_) out_ << '\n';
  printed_ = true;
  printLine(title);
  std::vector<Row> rows;
  for (Uint32 i = 0; i < object.getPropertyCount(); ++i) {
    const CIMConstProperty property = object.getProperty(i);
    rows.push_back({nameText(property.getName()), typeText(property),
                    hasTrueQualifier(property, "key") ? "yes" : "",
                    nameText(property.getClassOrigin()), cellText(property.getValue())});
  }
  printTable(out_, {"Property", "Type", "Key", "Origin", "Default"}, rows);
  rows.clear();
  for (Uint32 i = 0; i < object.getMethodCount(); ++i) {
    const CIMConstMethod method = object.getMethod(i);
    rows.push_back({nameText(method.getName()), cimTypeToString(method.getType()),
                    hasTrueQualifier(method, "static") ? "yes" : "", parametersText(method)});
  }
  if (!rows.empty()) printTable(out_ << '\n', {"Method", "Returns", "Static", "Parameters"}, rows);
  return static_cast<bool>(out_);
}

}  // namespace

std::unique_ptr<ResultWriter> makeTableWriter(std::ostream& out, ResultForm form) {
  return std::make_unique<TableWriter>(out, form);
}

}  // namespace cimhost
