#pragma once

#include <Pegasus/Common/Exception.h>

#include <atomic>
#include <vector>

#include "Element.h"
#include "NameMatcher.h"

PEGASUS_NAMESPACE_BEGIN

constexpr Uint32 kMaxElements = 1000;

/// The qualifiers, properties, parameters or methods of one container, by position and by name.
///
/// A copy is a deep copy. Where Rep::kSharedByCopies is set, it shares all that nobody holds a
/// handle to, until one side hands it out for change; the element that is handed out is then a copy
/// of that side's own. Copying and reading a list from several threads at once is safe.
///
/// A Rep is an Element with a copy constructor that copies deeply, freezeParts() and the constants
/// kKind (for messages) and kSharedByCopies.
template <class Rep>
class ElementList {
 public:
  ElementList() = default;
  ElementList(const ElementList& other) : block_(other.copiedBlock()) {}
  ElementList& operator=(const ElementList&) = delete;

  Uint32 size() const { return block_ ? static_cast<Uint32>(block_->items.size()) : 0; }

  Uint32 find(const CIMName& name) const {
    const NameMatcher matcher(name);
    const Uint32 count = size();
    for (Uint32 i = 0; i < count; ++i) {
      if (matcher.matches(block_->items[i]->name())) return i;
    }
    return PEG_NOT_FOUND;
  }

  /// For reading only.
  const Ref<Rep>& at(Uint32 index) const {
    if (index >= size()) throw IndexOutOfBoundsException();
    return block_->items[index];
  }

  /// The element as this list's own, to which a handle may be given.
  Ref<Rep> changeable(Uint32 index) {
    if (!at(index)->isFrozen()) return block_->items[index];
    makeUnique();
    Ref<Rep>& item = block_->items[index];
    if (item.isOnlyReference()) {
      item->thaw();
    } else {
      item = Ref<Rep>(new Rep(*item));
      item->enterContainer();
    }
    return item;
  }

  void add(const Ref<Rep>& element) {
    if (find(element->name()) != PEG_NOT_FOUND) {
      throw AlreadyExistsException(String(Rep::kKind) + String(" \"") +
                                   element->name().getString() + String("\""));
    }
    if (size() >= kMaxElements) {
      throw Exception("More than 1000 elements in a container are not supported.");
    }
    makeUnique();
    block_->items.push_back(element);
    element->enterContainer();
  }

  void remove(Uint32 index) {
    const Ref<Rep> removed = at(index);
    makeUnique();
    block_->items.erase(block_->items.begin() + index);
    if (!removed->isFrozen()) removed->leaveContainer();
  }

  void clear() { block_ = Ref<Block>(); }

  /// Freezes all that nobody holds a handle to; true when that is everything.
  bool freeze() const {
    if (!block_ || block_->frozen.load(std::memory_order_acquire)) return true;
    bool all = true;
    for (const Ref<Rep>& item : block_->items) all = freezeElement(item) && all;
    if (all) block_->frozen.store(true, std::memory_order_release);
    return all;
  }

  bool identical(const ElementList& other) const {
    if (block_.get() == other.block_.get()) return true;
    if (size() != other.size()) return false;
    for (Uint32 i = 0; i < size(); ++i) {
      if (!at(i)->identical(*other.at(i))) return false;
    }
    return true;
  }

 private:
  // Shared by several lists only while every element of it is frozen.
  struct Block final : Shareable {
    ~Block() override {
      for (const Ref<Rep>& item : items) {
        if (!item->isFrozen()) item->leaveContainer();
      }
    }
    std::vector<Ref<Rep>> items;
    mutable std::atomic<bool> frozen{false};
  };

  static bool freezeElement(const Ref<Rep>& item) {
    if (item->isFrozen()) return true;
    if (!item.isOnlyReference() || !item->freezeParts()) return false;
    item->freeze();
    return true;
  }

  static Ref<Rep> copiedElement(const Ref<Rep>& item) {
    if (Rep::kSharedByCopies && freezeElement(item)) return item;
    Ref<Rep> copy(new Rep(*item));
    copy->enterContainer();
    return copy;
  }

  Ref<Block> copiedBlock() const {
    if (!block_ || (Rep::kSharedByCopies && freeze())) return block_;
    Ref<Block> copy(new Block);
    copy->items.reserve(block_->items.size());
    for (const Ref<Rep>& item : block_->items) copy->items.push_back(copiedElement(item));
    return copy;
  }

  void makeUnique() {
    if (!block_) {
      block_ = Ref<Block>(new Block);
      block_->items.reserve(8);
    } else if (!block_.isOnlyReference()) {
      Ref<Block> own(new Block);
      own->items = block_->items;
      block_ = std::move(own);
    }
    block_->frozen.store(false, std::memory_order_relaxed);
  }

  Ref<Block> block_;
};

PEGASUS_NAMESPACE_END
