#pragma once

#include "cimhost/mof/MofDiagnostic.h"

#include <cstddef>
#include <memory>
#include <stdexcept>
#include <string>

namespace cimhost {

/// A MOF text and what it is called. Immutable; places in it are byte offsets.
struct MofSource {
  std::string name;  ///< For diagnostics; includes are relative to the folder part of it.
  std::string text;

  /// A diagnostic at `offset`, which may be the end of the text.
  MofDiagnostic diagnosticAt(std::size_t offset, const std::string& message) const;
};

using MofSourcePtr = std::shared_ptr<const MofSource>;

/// What stops the reading of a file; leaves the folder only as a diagnostic.
class MofError : public std::runtime_error {
 public:
  explicit MofError(MofDiagnostic diagnostic)
      : std::runtime_error(diagnostic.message), diagnostic_(std::move(diagnostic)) {}
  MofError(const MofSource& source, std::size_t offset, const std::string& message)
      : MofError(source.diagnosticAt(offset, message)) {}

  const MofDiagnostic& diagnostic() const { return diagnostic_; }

 private:
  MofDiagnostic diagnostic_;
};

/// Reads a regular file of at most 64 MiB; throws std::runtime_error, whose text is the reason.
/// A pipe or device is refused, not waited for.
MofSourcePtr readMofFile(const std::string& path);

}  // namespace cimhost
