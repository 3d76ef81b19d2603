#include <Pegasus/Common/OperationContext.h>

PEGASUS_NAMESPACE_BEGIN

OperationContext::Container::~Container() = default;

OperationContext::OperationContext() = default;

OperationContext::OperationContext(const OperationContext& context) {
  *this = context;
}

OperationContext::~OperationContext() {
  clear();
}

OperationContext& OperationContext::operator=(const OperationContext& context) {
  if (this == &context) return *this;
  clear();
  containers_.reserve(context.containers_.size());
  for (const Container* container : context.containers_) {
    containers_.push_back(container->clone());
  }
  return *this;
}

void OperationContext::clear() {
  for (Container* container : containers_) container->destroy();
  containers_.clear();
}

std::size_t OperationContext::indexOf(const String& containerName) const {
  std::size_t index = 0;
  while (index < containers_.size() && containers_[index]->getName() != containerName) ++index;
  return index;
}

std::size_t OperationContext::requiredIndexOf(const String& containerName) const {
  const std::size_t index = indexOf(containerName);
  if (index == containers_.size()) throw Exception("object not found");
  return index;
}

const OperationContext::Container& OperationContext::get(const String& containerName) const {
  return *containers_[requiredIndexOf(containerName)];
}

Boolean OperationContext::contains(const String& containerName) const {
  return indexOf(containerName) < containers_.size();
}

void OperationContext::set(const Container& container) {
  const std::size_t index = requiredIndexOf(container.getName());
  // Cloned first: the argument may be the container that is replaced.
  Container* const clone = container.clone();
  containers_[index]->destroy();
  containers_[index] = clone;
}

void OperationContext::insert(const Container& container) {
  if (contains(container.getName())) throw Exception("object already exists.");
  containers_.reserve(containers_.size() + 1);
  containers_.push_back(container.clone());
}

void OperationContext::remove(const String& containerName) {
  const std::size_t index = requiredIndexOf(containerName);
  containers_[index]->destroy();
  containers_.erase(containers_.begin() + static_cast<std::ptrdiff_t>(index));
}

const String IdentityContainer::NAME("IdentityContainer");

IdentityContainer::IdentityContainer(const OperationContext::Container& container) {
  const auto* identity = dynamic_cast<const IdentityContainer*>(&container);
  if (!identity) throw DynamicCastFailedException();
  userName_ = identity->userName_;
}

IdentityContainer::IdentityContainer(const IdentityContainer& container)
    : OperationContext::Container(container), userName_(container.userName_) {}

IdentityContainer::IdentityContainer(const String& userName) : userName_(userName) {}

IdentityContainer::~IdentityContainer() = default;

IdentityContainer& IdentityContainer::operator=(const IdentityContainer& container) = default;

String IdentityContainer::getName() const {
  return NAME;
}

OperationContext::Container* IdentityContainer::clone() const {
  return new IdentityContainer(*this);
}

void IdentityContainer::destroy() {
  delete this;
}

String IdentityContainer::getUserName() const {
  return userName_;
}

PEGASUS_NAMESPACE_END
