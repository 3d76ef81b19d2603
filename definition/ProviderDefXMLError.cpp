#include "definition/ProviderDefXMLError.h"

void processException(const std::string& element, const std::string& name,
                      ProviderDefXMLError& error) {
  error.append("\n" + element + ":" + name + "\n");
}
