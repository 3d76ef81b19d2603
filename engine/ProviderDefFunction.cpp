#include "engine/ProviderDefFunction.h"

#include "diagnostics/debug.h"
#include "engine/ProviderDefError.h"
#include "engine/ProviderDefModule.h"

#include <optional>

// The argument after a function's own data: none, a number, a text, or a packed buffer.
struct ProviderDefFunction::Extra {
  Suffix suffix = Suffix::kNone;
  int number = 0;
  const char* text = nullptr;
  std::optional<CallBuffer> buffer;
};

ProviderDefFunction::ProviderDefFunction(const ProviderDefFunction& other)
    : name_(other.name_),
      type_(other.type_),
      module_(other.module_),
      loaded_(other.loaded_.load()) {
  for (size_t i = 0; i < slots_.size(); ++i) slots_[i].store(other.slots_[i].load());
}

int ProviderDefFunction::loadFunction() {
  if (loaded_.load(std::memory_order_acquire)) return 0;
  const int own = slot();
  if (own < 0) return 0;
  if (module_ == nullptr) throw ProviderDefError("Couldn't load function " + name_);
  slots_[static_cast<size_t>(own)].store(module_->getFunction(name_), std::memory_order_relaxed);
  // Required as it is: an execC function is judged by the slot of execB with the same suffix, which
  // stays empty, so it is never marked as resolved and is looked up again at every call.
  const size_t judged =
      static_cast<size_t>(own) - (familyOfSlot(own) == Family::kExecC ? kSuffixes : 0);
  if (slots_[judged].load(std::memory_order_relaxed) == nullptr) return 1;
  loaded_.store(true, std::memory_order_release);
  return 0;
}

bool ProviderDefFunction::isType(Family family, Suffix suffix) const {
  const int own = slot();
  return own >= 0 && familyOfSlot(own) == family && suffixOfSlot(own) == suffix;
}

void* ProviderDefFunction::entry() {
  return slots_[static_cast<size_t>(slot())].load(std::memory_order_relaxed);
}

void ProviderDefFunction::logExec() const {
  DEBUG_FORMAT(7, "ProviderDefFunction::exec(void) Type:%d\n", type_);
}

void ProviderDefFunction::failInput() const {
  throw ProviderDefError("The input of function " + name_ + " does not fit into its buffer");
}

void ProviderDefFunction::failResult() const {
  throw ProviderDefError("The result of function " + name_ + " does not fit into its buffer");
}

void ProviderDefFunction::checkIntact(const CallBuffer& buffer) const {
  if (!buffer.isIntact()) {
    throw ProviderDefError("Function " + name_ + " wrote past the end of its buffer");
  }
}

// Takes `value` as the extra argument of a function of this suffix; false when its type does not
// fit.
bool ProviderDefFunction::takeExtra(Extra& extra, Suffix suffix,
                                    const ProviderDefValue& value) const {
  extra.suffix = suffix;
  switch (suffix) {
    case Suffix::kI:
      extra.number = value.getIntValue();
      return value.getType() == ProviderDefValue::kInteger;
    case Suffix::kW:
      extra.text = value.getStringValue().c_str();
      return value.getType() == ProviderDefValue::kString;
    case Suffix::kV: {
      CallBuffer& buffer = extra.buffer.emplace();
      if (value.getType() == ProviderDefValue::kIntArray) {
        packAI(buffer.begin(), buffer.end(), value.getIntArray());
        return true;
      }
      if (value.getType() == ProviderDefValue::kStringArray) {
        packAS(buffer.begin(), buffer.end(), value.getStringArray());
        return true;
      }
      return false;
    }
    default:
      return false;
  }
}

// The one place where a symbol becomes a function: its own arguments, then the extra one.
template <class Result, class... Arguments>
Result ProviderDefFunction::call(void* entry, const Extra& extra, Arguments... arguments) const {
  switch (extra.suffix) {
    case Suffix::kI:
      return reinterpret_cast<Result (*)(Arguments..., int)>(entry)(arguments..., extra.number);
    case Suffix::kW:
      return reinterpret_cast<Result (*)(Arguments..., const char*)>(entry)(arguments...,
                                                                            extra.text);
    case Suffix::kV: {
      CallBuffer& buffer = const_cast<CallBuffer&>(*extra.buffer);
      const Result result =
          reinterpret_cast<Result (*)(Arguments..., void*)>(entry)(arguments..., buffer.begin());
      checkIntact(buffer);
      return result;
    }
    default:
      return reinterpret_cast<Result (*)(Arguments...)>(entry)(arguments...);
  }
}

int ProviderDefFunction::callSet(const ProviderDefValue& value, const Extra& extra) {
  const auto callWithBuffer = [&](auto pack) {
    CallBuffer in;
    pack(in);
    const int result = call<int, void*>(entry(), extra, in.begin());
    checkIntact(in);
    return result;
  };
  switch (familyOfSlot(slot())) {
    case Family::kSetI:
      return call<int, int>(entry(), extra, value.getIntValue());
    case Family::kSetS:
      return call<int, const char*>(entry(), extra, value.getStringValue().c_str());
    case Family::kSetAI:
      return callWithBuffer(
          [&](CallBuffer& in) { packAI(in.begin(), in.end(), value.getIntArray()); });
    case Family::kSetAS:
      return callWithBuffer(
          [&](CallBuffer& in) { packAS(in.begin(), in.end(), value.getStringArray()); });
    default:
      return 0;
  }
}

ProviderDefValue ProviderDefFunction::callGet(const Extra& extra) {
  const auto callWithBuffer = [&](auto make) -> ProviderDefValue {
    CallBuffer out;
    call<int, void*>(entry(), extra, out.begin());
    checkIntact(out);
    return make(out.begin(), out.end());
  };
  switch (familyOfSlot(slot())) {
    case Family::kGetI:
      return ProviderDefValue(call<int>(entry(), extra));
    case Family::kGetL:
      return ProviderDefValue(call<long>(entry(), extra));
    case Family::kGetS:
      return callWithBuffer([this](const char* text, const char* end) {
        // The text starts at the buffer's start; makeS skips an item's header of 8 bytes.
        const char* nul = text;
        while (nul != end && *nul != '\0') ++nul;
        if (nul == end) failResult();
        return std::string(text, nul);
      });
    case Family::kGetAI:
      return callWithBuffer(
          [this](const char* item, const char* end) { return makeAI(item, nullptr, end); });
    case Family::kGetAS:
      return callWithBuffer(
          [this](const char* item, const char* end) { return makeAS(item, nullptr, end); });
    default:
      return ProviderDefValue();
  }
}

int ProviderDefFunction::callExec(const Extra& extra, const Values* inputs, Values* outputs) {
  if (inputs == nullptr) return call<int>(entry(), extra);
  CallBuffer in;
  packList(in.begin(), in.end(), *inputs, true);
  if (outputs == nullptr) {
    const int result = call<int, void*>(entry(), extra, in.begin());
    checkIntact(in);
    return result;
  }
  CallBuffer out;
  packList(out.begin(), out.end(), Values(), true);  // a plug-in that writes nothing sends nothing
  const int result = call<int, void*, void*>(entry(), extra, in.begin(), out.begin());
  checkIntact(in);
  checkIntact(out);
  readOutputs(out.begin(), out.end(), *outputs);
  return result;
}

namespace {

bool isSet(int slot) {
  return slot >= 0 && familyOfSlot(slot) <= Family::kSetAS;
}
bool isGet(int slot) {
  return slot >= 0 && familyOfSlot(slot) >= Family::kGetI && familyOfSlot(slot) <= Family::kGetL;
}
bool isOf(int slot, Family family) {
  return slot >= 0 && familyOfSlot(slot) == family;
}

}  // namespace

int ProviderDefFunction::set(const ProviderDefValue& value) {
  loadFunction();
  if (!isSet(slot()) || suffixOfSlot(slot()) != Suffix::kNone) return 0;
  return callSet(value, Extra());
}

int ProviderDefFunction::set(const ProviderDefValue& value, const ProviderDefValue& value2) {
  loadFunction();
  if (!isSet(slot()) || suffixOfSlot(slot()) == Suffix::kNone) return 0;
  Extra extra;
  const bool fits = takeExtra(extra, suffixOfSlot(slot()), value2);
  // A set function reads the integer or the string field whatever the value's own type.
  if (!fits && extra.suffix == Suffix::kV) return 0;
  return callSet(value, extra);
}

int ProviderDefFunction::set(const ProviderDefValue& value, const Values& extras) {
  loadFunction();
  if (!isSet(slot()) || suffixOfSlot(slot()) != Suffix::kV) return 0;
  Extra extra;
  extra.suffix = Suffix::kV;
  CallBuffer& buffer = extra.buffer.emplace();
  packList(buffer.begin(), buffer.end(), extras, false);
  return callSet(value, extra);
}

ProviderDefValue ProviderDefFunction::get() {
  DEBUG_FORMAT(7, "ProviderDefFunction::get(void) Type:%d\n", type_);
  loadFunction();
  if (!isGet(slot()) || suffixOfSlot(slot()) != Suffix::kNone) return ProviderDefValue();
  return callGet(Extra());
}

ProviderDefValue ProviderDefFunction::get(const ProviderDefValue& value) {
  loadFunction();
  Extra extra;
  if (!isGet(slot()) || !takeExtra(extra, suffixOfSlot(slot()), value)) return ProviderDefValue();
  ProviderDefValue result = callGet(extra);
  if (isType(Family::kGetL, Suffix::kI)) {
    DEBUG_FORMAT(8, "DEBUG function call %s: %ld\n", name_.c_str(), result.getLongValue());
  }
  return result;
}

ProviderDefValue ProviderDefFunction::get(const Values& extras) {
  loadFunction();
  if (!isGet(slot()) || suffixOfSlot(slot()) != Suffix::kV) return ProviderDefValue();
  Extra extra;
  extra.suffix = Suffix::kV;
  CallBuffer& buffer = extra.buffer.emplace();
  packList(buffer.begin(), buffer.end(), extras, false);
  return callGet(extra);
}

int ProviderDefFunction::exec() {
  logExec();
  loadFunction();
  if (!isType(Family::kExecA, Suffix::kNone)) return kExecNotSupported;
  return callExec(Extra(), nullptr, nullptr);
}

int ProviderDefFunction::exec(const ProviderDefValue& value) {
  logExec();
  loadFunction();
  if (!isOf(slot(), Family::kExecA)) return kExecNotSupported;
  Extra extra;
  // A function without extra argument ignores the value.
  if (!isType(Family::kExecA, Suffix::kNone) && !takeExtra(extra, suffixOfSlot(slot()), value)) {
    return kExecNotSupported;
  }
  return callExec(extra, nullptr, nullptr);
}

int ProviderDefFunction::exec(const Values& inputs) {
  logExec();
  loadFunction();
  if (!isType(Family::kExecB, Suffix::kNone)) return kExecNotSupported;
  return callExec(Extra(), &inputs, nullptr);
}

int ProviderDefFunction::exec(const ProviderDefValue& value, const Values& inputs) {
  logExec();
  loadFunction();
  if (!isOf(slot(), Family::kExecB)) return kExecNotSupported;
  Extra extra;
  if (!isType(Family::kExecB, Suffix::kNone) && !takeExtra(extra, suffixOfSlot(slot()), value)) {
    return kExecNotSupported;
  }
  return callExec(extra, &inputs, nullptr);
}

int ProviderDefFunction::exec(const Values& inputs, Values& outputs) {
  logExec();
  loadFunction();
  if (!isType(Family::kExecC, Suffix::kNone)) return kExecNotSupported;
  return callExec(Extra(), &inputs, &outputs);
}

int ProviderDefFunction::exec(const ProviderDefValue& value, const Values& inputs,
                              Values& outputs) {
  logExec();
  loadFunction();
  if (!isOf(slot(), Family::kExecC)) return kExecNotSupported;
  Extra extra;
  if (!isType(Family::kExecC, Suffix::kNone) && !takeExtra(extra, suffixOfSlot(slot()), value)) {
    return kExecNotSupported;
  }
  return callExec(extra, &inputs, &outputs);
}
