#ifndef CIMOM_BROKER_MESSAGESINK_H_
#define CIMOM_BROKER_MESSAGESINK_H_

#include <functional>
#include <string_view>

namespace Cimom {

/// Takes a message that a provider logs or traces: its severity (CMPI_SEV_…) or level (CMPI_LEV_…), the component that
/// sends it and the text. It may be called from several threads at once.
using MessageSink = std::function<void(int level, std::string_view component, std::string_view text)>;

}  // namespace Cimom

#endif  // CIMOM_BROKER_MESSAGESINK_H_
