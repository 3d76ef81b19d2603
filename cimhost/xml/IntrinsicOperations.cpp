// The operations of DSP0200 (5.3) in CIM-XML: their parameters with the defaults of the standard,
// and the form of their results.

#include "cimhost/Text.h"
#include "cimhost/output/XmlText.h"
#include "cimhost/xml/CallParameters.h"
#include "cimhost/xml/CimCall.h"

#include <strings.h>
#include <algorithm>
#include <iterator>

namespace cimhost {

using namespace Pegasus;

namespace {

// The forms that results have in replies.
enum class Form { plain, named, withPath };

class ReplySink final : public InstanceSink,
                        public ObjectPathSink,
                        public ClassSink,
                        public ClassNameSink {
 public:
  ReplySink(ReplyWriter& writer, Form form) : writer_(writer), form_(form) {}

  bool deliverInstance(const CIMInstance& instance) override {
    XmlBuffer& out = writer_.next();
    if (form_ == Form::named) {
      out.append("<VALUE.NAMEDINSTANCE>");
      appendInstanceName(out, instance.getPath());
      appendInstance(out, instance);
      out.append("</VALUE.NAMEDINSTANCE>");
    } else if (form_ == Form::withPath) {
      out.append("<VALUE.OBJECTWITHPATH>");
      appendInstancePath(out, instance.getPath());
      appendInstance(out, instance);
      out.append("</VALUE.OBJECTWITHPATH>");
    } else {
      appendInstance(out, instance);
    }
    return writer_.written();
  }

  bool deliverPath(const CIMObjectPath& path) override {
    XmlBuffer& out = writer_.next();
    if (form_ == Form::withPath) {
      out.append("<OBJECTPATH>");
      appendInstancePath(out, path);
      out.append("</OBJECTPATH>");
    } else {
      appendInstanceName(out, path);
    }
    return writer_.written();
  }

  bool deliverClass(const CIMClass& declaration) override {
    appendClass(writer_.next(), declaration);
    return writer_.written();
  }

  bool deliverClassName(const CIMName& name) override {
    appendClassName(writer_.next(), name);
    return writer_.written();
  }

 private:
  ReplyWriter& writer_;
  Form form_;
};

struct Work {
  const CimCall& call;
  const CallParameters& parameters;
  ReplySink& sink;

  const Operations& operations() const { return call.operations; }
  const CIMNamespaceName& nameSpace() const { return call.nameSpace; }
  CIMName className() const {
    CIMName name = parameters.requiredClassName("ClassName");
    call.isAbout(name);
    return name;
  }
  CIMObjectPath instanceName() const {
    CIMObjectPath path = parameters.instanceName("InstanceName");
    call.isAbout(path.getClassName());
    return path;
  }
  CIMObjectPath objectName() const {
    CIMObjectPath path = parameters.objectName("ObjectName");
    call.isAbout(path.getClassName());
    return path;
  }
  bool flag(std::string_view name, bool otherwise) const {
    return parameters.boolean(name, otherwise);
  }
};

InstanceSelection selectionOf(const Work& work, bool localOnly) {
  return {work.flag("DeepInheritance", true), localOnly, work.flag("IncludeQualifiers", false),
          work.flag("IncludeClassOrigin", false), work.parameters.propertyList("PropertyList")};
}

OperationStatus enumerateInstances(const Work& work) {
  const EnumerateInstancesRequest request{work.nameSpace(), work.className(),
                                          selectionOf(work, work.flag("LocalOnly", true))};
  return work.operations().enumerateInstances(work.call.context, request, work.sink);
}

OperationStatus enumerateInstanceNames(const Work& work) {
  return work.operations().enumerateInstanceNames(work.call.context,
                                                  {work.nameSpace(), work.className()}, work.sink);
}

OperationStatus getInstance(const Work& work) {
  const GetInstanceRequest request{work.nameSpace(), work.instanceName(),
                                   selectionOf(work, work.flag("LocalOnly", true))};
  return work.operations().getInstance(work.call.context, request, work.sink);
}

OperationStatus modifyInstance(const Work& work) {
  const XmlElement& named = work.parameters.require("ModifiedInstance", "VALUE.NAMEDINSTANCE");
  const CIMInstance instance = readParameter("parameter ModifiedInstance", [&] {
    if (named.children.size() != 2 || !named.children[0].is("INSTANCENAME") ||
        !named.children[1].is("INSTANCE")) {
      throw ValueArgumentError("a name and an instance are expected");
    }
    CIMInstance result = readInstance(named.children[1]);
    result.setPath(readObjectPath(named.children[0]));
    return result;
  });
  work.call.isAbout(instance.getClassName());
  return work.operations().modifyInstance(
      work.call.context, {work.nameSpace(), instance, work.flag("IncludeQualifiers", true),
                          work.parameters.propertyList("PropertyList")});
}

OperationStatus createInstance(const Work& work) {
  const CIMInstance instance = readParameter("parameter NewInstance", [&] {
    return readInstance(work.parameters.require("NewInstance", "INSTANCE"));
  });
  work.call.isAbout(instance.getClassName());
  return work.operations().createInstance(work.call.context, {work.nameSpace(), instance},
                                          work.sink);
}

OperationStatus deleteInstance(const Work& work) {
  return work.operations().deleteInstance(work.call.context,
                                          {work.nameSpace(), work.instanceName()});
}

// The declaration of a property of an instance's class.
CIMProperty declaredProperty(const Work& work, const CIMName& className, const CIMName& name) {
  if (!work.call.repository.hasClass(work.nameSpace(), className)) {
    throw CIMException(CIM_ERR_INVALID_CLASS, className.getString());
  }
  CIMClass declaration = work.call.repository.getClass(work.nameSpace(), className, false, true,
                                                       true, CIMPropertyList());
  const Uint32 position = declaration.findProperty(name);
  if (position == PEG_NOT_FOUND) throw CIMException(CIM_ERR_NO_SUCH_PROPERTY, name.getString());
  return declaration.getProperty(position);
}

// The value of the one property that was asked for, without a PROPERTY around it.
class PropertySink final : public InstanceSink {
 public:
  PropertySink(ReplyWriter& writer, CIMName name) : writer_(writer), name_(std::move(name)) {}

  bool deliverInstance(const CIMInstance& instance) override {
    const Uint32 position = instance.findProperty(name_);
    XmlBuffer& out = writer_.next();
    if (position != PEG_NOT_FOUND) appendValue(out, instance.getProperty(position).getValue());
    return writer_.written();
  }

 private:
  ReplyWriter& writer_;
  CIMName name_;
};

CIMPropertyList listOf(const CIMName& name) {
  Array<CIMName> names;
  names.append(name);
  return CIMPropertyList(names);
}

OperationStatus getProperty(const Work& work) {
  const CIMObjectPath path = work.instanceName();
  const CIMName name = work.parameters.name("PropertyName");
  declaredProperty(work, path.getClassName(), name);
  InstanceSelection selection;
  selection.propertyList = listOf(name);
  PropertySink sink(work.call.writer, name);
  return work.operations().getInstance(work.call.context, {work.nameSpace(), path, selection},
                                       sink);
}

OperationStatus setProperty(const Work& work) {
  const CIMObjectPath path = work.instanceName();
  const CIMName name = work.parameters.name("PropertyName");
  const CIMProperty property = declaredProperty(work, path.getClassName(), name);
  const DeclaredType declared{property.getType(), static_cast<bool>(property.isArray()),
                              property.getArraySize()};
  const CIMInstance instance = readParameter(
      "parameter NewValue",
      [&] {
        CIMInstance result(path.getClassName());
        result.setPath(path);
        result.addProperty(CIMProperty(property.getName(),
                                       readValue(declared, work.parameters.find("NewValue")),
                                       declared.arraySize, property.getReferenceClassName()));
        return result;
      },
      CIM_ERR_TYPE_MISMATCH);
  return work.operations().modifyInstance(
      work.call.context, {work.nameSpace(), instance, true, listOf(property.getName())});
}

AssociationFilter filterOf(const Work& work) {
  return {work.parameters.className("AssocClass"), work.parameters.className("ResultClass"),
          work.parameters.text("Role"), work.parameters.text("ResultRole")};
}

// What DSP0200 calls ResultClass there is an association class.
AssociationFilter referenceFilterOf(const Work& work) {
  return {work.parameters.className("ResultClass"), CIMName(), work.parameters.text("Role"),
          String()};
}

OperationStatus associators(const Work& work) {
  const AssociatorsRequest request{work.nameSpace(), work.objectName(), filterOf(work),
                                   selectionOf(work, false)};
  return work.operations().associators(work.call.context, request, work.sink);
}

OperationStatus associatorNames(const Work& work) {
  return work.operations().associatorNames(
      work.call.context, {work.nameSpace(), work.objectName(), filterOf(work)}, work.sink);
}

OperationStatus references(const Work& work) {
  const ReferencesRequest request{work.nameSpace(), work.objectName(), referenceFilterOf(work),
                                  selectionOf(work, false)};
  return work.operations().references(work.call.context, request, work.sink);
}

OperationStatus referenceNames(const Work& work) {
  return work.operations().referenceNames(
      work.call.context, {work.nameSpace(), work.objectName(), referenceFilterOf(work)}, work.sink);
}

OperationStatus getClass(const Work& work) {
  const GetClassRequest request{work.nameSpace(),
                                work.className(),
                                work.flag("LocalOnly", true),
                                work.flag("IncludeQualifiers", true),
                                work.flag("IncludeClassOrigin", false),
                                work.parameters.propertyList("PropertyList")};
  return work.operations().getClass(request, work.sink);
}

OperationStatus enumerateClasses(const Work& work) {
  const EnumerateClassesRequest request{
      work.nameSpace(),
      work.parameters.className("ClassName"),
      work.flag("DeepInheritance", false),
      work.flag("LocalOnly", true),
      work.flag("IncludeQualifiers", true),
      work.flag("IncludeClassOrigin", false),
  };
  work.call.isAbout(request.className);
  return work.operations().enumerateClasses(request, work.sink);
}

OperationStatus enumerateClassNames(const Work& work) {
  const EnumerateClassNamesRequest request{work.nameSpace(), work.parameters.className("ClassName"),
                                           work.flag("DeepInheritance", false)};
  work.call.isAbout(request.className);
  return work.operations().enumerateClassNames(request, work.sink);
}

// The qualifier with that name, or with a null name all.
OperationStatus sendQualifiers(const Work& work, const CIMName& name) {
  for (const QualifierDeclaration& each : work.call.repository.qualifiers(work.nameSpace())) {
    if (!name.isNull() && each.qualifier.getName() != name) continue;
    appendQualifierDeclaration(work.call.writer.next(), each.qualifier, each.scope);
    if (!work.call.writer.written()) break;
  }
  return {};
}

OperationStatus getQualifier(const Work& work) {
  const CIMName name = work.parameters.name("QualifierName");
  work.call.isAbout(name);
  if (work.call.repository.findQualifier(work.nameSpace(), name).isUninitialized()) {
    throw CIMException(CIM_ERR_NOT_FOUND, name.getString());
  }
  return sendQualifiers(work, name);
}

OperationStatus enumerateQualifiers(const Work& work) {
  return sendQualifiers(work, CIMName());
}

struct OperationRow {
  std::string_view name;
  OperationStatus (*run)(const Work&);
  Form form;
  bool withResult;
  std::string_view parameters;
};

#define SELECTION "IncludeQualifiers IncludeClassOrigin PropertyList"

constexpr OperationRow kOperations[] = {
    {"Associators", associators, Form::withPath, true,
     "ObjectName AssocClass ResultClass Role ResultRole " SELECTION},
    {"AssociatorNames", associatorNames, Form::withPath, true,
     "ObjectName AssocClass ResultClass Role ResultRole"},
    {"CreateInstance", createInstance, Form::plain, true, "NewInstance"},
    {"DeleteInstance", deleteInstance, Form::plain, false, "InstanceName"},
    {"EnumerateClasses", enumerateClasses, Form::plain, true,
     "ClassName DeepInheritance LocalOnly IncludeQualifiers IncludeClassOrigin"},
    {"EnumerateClassNames", enumerateClassNames, Form::plain, true, "ClassName DeepInheritance"},
    {"EnumerateInstances", enumerateInstances, Form::named, true,
     "ClassName LocalOnly DeepInheritance " SELECTION},
    {"EnumerateInstanceNames", enumerateInstanceNames, Form::plain, true, "ClassName"},
    {"EnumerateQualifiers", enumerateQualifiers, Form::plain, true, ""},
    {"GetClass", getClass, Form::plain, true, "ClassName LocalOnly " SELECTION},
    {"GetInstance", getInstance, Form::plain, true, "InstanceName LocalOnly " SELECTION},
    {"GetProperty", getProperty, Form::plain, true, "InstanceName PropertyName"},
    {"GetQualifier", getQualifier, Form::plain, true, "QualifierName"},
    {"ModifyInstance", modifyInstance, Form::plain, false,
     "ModifiedInstance IncludeQualifiers PropertyList"},
    {"References", references, Form::withPath, true, "ObjectName ResultClass Role " SELECTION},
    {"ReferenceNames", referenceNames, Form::withPath, true, "ObjectName ResultClass Role"},
    {"SetProperty", setProperty, Form::plain, false, "InstanceName PropertyName NewValue"},
};

const OperationRow* findOperation(const std::string& name) {
  const auto* const found =
      std::find_if(std::begin(kOperations), std::end(kOperations), [&](const OperationRow& row) {
        return row.name.size() == name.size() &&
               strncasecmp(row.name.data(), name.data(), name.size()) == 0;
      });
  return found == std::end(kOperations) ? nullptr : found;
}

}  // namespace

OperationStatus runIntrinsic(const CimCall& call) {
  const OperationRow* const row = findOperation(call.message.method());
  if (row == nullptr) throw CIMException(CIM_ERR_NOT_SUPPORTED, fromUtf8(call.message.method()));
  // Of several errors DSP0200 wants this one rather than those of parameters.
  if (!call.repository.hasNamespace(call.nameSpace)) {
    throw CIMException(CIM_ERR_INVALID_NAMESPACE, call.nameSpace.getString());
  }
  if (row->withResult) call.writer.wrapResults();
  ReplySink sink(call.writer, row->form);
  const CallParameters parameters(call.message.call(), row->parameters);
  return row->run({call, parameters, sink});
}

}  // namespace cimhost
