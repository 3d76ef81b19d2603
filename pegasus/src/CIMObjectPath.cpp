#include <Pegasus/Common/CIMObjectPath.h>

#include <atomic>
#include <utility>

#include "HostName.h"
#include "ObjectPathParser.h"

PEGASUS_NAMESPACE_BEGIN

struct CIMObjectPathRep {
  std::atomic<Uint32> references{1};
  ObjectPathParts parts;
};

namespace {

// Shared by all empty paths and never counted; lives as long as the process.
CIMObjectPathRep* emptyRep() {
  static CIMObjectPathRep* const kEmpty = new CIMObjectPathRep;
  return kEmpty;
}

CIMObjectPathRep* share(CIMObjectPathRep* rep) {
  if (rep != emptyRep()) rep->references.fetch_add(1, std::memory_order_relaxed);
  return rep;
}

void release(CIMObjectPathRep* rep) {
  if (rep == emptyRep()) return;
  if (rep->references.fetch_sub(1, std::memory_order_acq_rel) == 1) delete rep;
}

[[noreturn]] void throwMalformed(const String& text, const String& reason) {
  throw MalformedObjectNameException(text + ", reason:\"" + reason + "\"");
}

void requireLegalHost(const String& host) {
  if (host.size() > 0 && !isLegalHost(host)) throwMalformed(host, "invalid hostname");
}

void parseOrThrow(const String& text, ObjectPathParts& parts) {
  String reason;
  if (!parseObjectPath(text, parts, &reason)) throwMalformed(text, reason);
}

// Sorted, and references in canonical form; shares `keyBindings` when there is nothing to change.
Array<CIMKeyBinding> canonical(const Array<CIMKeyBinding>& keyBindings) {
  Array<CIMKeyBinding> keys(keyBindings);
  sortKeyBindings(keys);
  for (Uint32 i = 0; i < keys.size(); ++i) {
    const CIMKeyBinding& key = keys.getData()[i];
    if (key.getType() != CIMKeyBinding::REFERENCE) continue;
    ObjectPathParts reference;
    parseOrThrow(key.getValue(), reference);
    const String text = formatObjectPath(reference);
    if (text != key.getValue()) keys[i].setValue(text);
  }
  return keys;
}

void hashNoCase(Uint32& hash, const String& text) {
  for (Uint32 i = 0; i < text.size(); ++i) {
    const Uint16 unit = text.getChar16Data()[i];
    const bool upper = unit >= 'A' && unit <= 'Z';
    hash = (hash ^ (upper ? unit + 32u : unit)) * 16777619u;  // FNV-1a
  }
}

}  // namespace

CIMObjectPath::CIMObjectPath(CIMObjectPathRep* rep) : rep_(rep) {}

CIMObjectPath::CIMObjectPath() : rep_(emptyRep()) {}

CIMObjectPath::CIMObjectPath(const CIMObjectPath& x) : rep_(share(x.rep_)) {}

CIMObjectPath::CIMObjectPath(CIMObjectPath&& x) noexcept
    : rep_(std::exchange(x.rep_, emptyRep())) {}

CIMObjectPath::CIMObjectPath(const String& objectName) : CIMObjectPath() {
  set(objectName);
}

CIMObjectPath::CIMObjectPath(const String& host, const CIMNamespaceName& nameSpace,
                             const CIMName& className, const Array<CIMKeyBinding>& keyBindings)
    : CIMObjectPath() {
  set(host, nameSpace, className, keyBindings);
}

CIMObjectPath::~CIMObjectPath() {
  release(rep_);
}

CIMObjectPath& CIMObjectPath::operator=(const CIMObjectPath& x) {
  CIMObjectPath copy(x);
  std::swap(rep_, copy.rep_);
  return *this;
}

CIMObjectPath& CIMObjectPath::operator=(CIMObjectPath&& x) noexcept {
  std::swap(rep_, x.rep_);
  return *this;
}

CIMObjectPath& CIMObjectPath::operator=(const String& objectName) {
  set(objectName);
  return *this;
}

CIMObjectPathRep* CIMObjectPath::makeUnique() {
  if (rep_ == emptyRep() || rep_->references.load(std::memory_order_acquire) != 1) {
    CIMObjectPath fresh(new CIMObjectPathRep);
    fresh.rep_->parts = rep_->parts;
    std::swap(rep_, fresh.rep_);
  }
  return rep_;
}

void CIMObjectPath::clear() {
  *this = CIMObjectPath();
}

void CIMObjectPath::set(const String& host, const CIMNamespaceName& nameSpace,
                        const CIMName& className, const Array<CIMKeyBinding>& keyBindings) {
  requireLegalHost(host);
  CIMObjectPath fresh(new CIMObjectPathRep);
  fresh.rep_->parts = {host, nameSpace, className, keyBindings};
  std::swap(rep_, fresh.rep_);
  rep_->parts.keyBindings = canonical(rep_->parts.keyBindings);
}

void CIMObjectPath::set(const String& objectName) {
  const String text(objectName);  // it may be a part of this path
  clear();
  parseOrThrow(text, makeUnique()->parts);
}

const String& CIMObjectPath::getHost() const {
  return rep_->parts.host;
}

// The setters copy their argument first: it may be a part of the representation that they leave.
void CIMObjectPath::setHost(const String& host) {
  requireLegalHost(host);
  String copy(host);
  makeUnique()->parts.host = std::move(copy);
}

const CIMNamespaceName& CIMObjectPath::getNameSpace() const {
  return rep_->parts.nameSpace;
}

void CIMObjectPath::setNameSpace(const CIMNamespaceName& nameSpace) {
  CIMNamespaceName copy(nameSpace);
  makeUnique()->parts.nameSpace = std::move(copy);
}

const CIMName& CIMObjectPath::getClassName() const {
  return rep_->parts.className;
}

void CIMObjectPath::setClassName(const CIMName& className) {
  CIMName copy(className);
  makeUnique()->parts.className = std::move(copy);
}

const Array<CIMKeyBinding>& CIMObjectPath::getKeyBindings() const {
  return rep_->parts.keyBindings;
}

void CIMObjectPath::setKeyBindings(const Array<CIMKeyBinding>& keyBindings) {
  Array<CIMKeyBinding> keys(keyBindings);
  Array<CIMKeyBinding>& own = makeUnique()->parts.keyBindings;
  own = std::move(keys);
  own = canonical(own);
}

String CIMObjectPath::toString() const {
  return formatObjectPath(rep_->parts);
}

Boolean CIMObjectPath::identical(const CIMObjectPath& x) const {
  return rep_ == x.rep_ || identicalPaths(rep_->parts, x.rep_->parts);
}

// Numbers, truth values and references are equal in several spellings: of them the name alone
// counts.
Uint32 CIMObjectPath::makeHashCode() const {
  Uint32 hash = 2166136261u;
  hashNoCase(hash, getHost());
  hashNoCase(hash, getNameSpace().getString());
  hashNoCase(hash, getClassName().getString());
  const Array<CIMKeyBinding>& keys = getKeyBindings();
  for (Uint32 i = 0; i < keys.size(); ++i) {
    hashNoCase(hash, keys[i].getName().getString());
    if (keys[i].getType() == CIMKeyBinding::STRING) hashNoCase(hash, keys[i].getValue());
  }
  return hash;
}

bool operator==(const CIMObjectPath& x, const CIMObjectPath& y) {
  return x.identical(y);
}
bool operator!=(const CIMObjectPath& x, const CIMObjectPath& y) {
  return !x.identical(y);
}

PEGASUS_NAMESPACE_END
