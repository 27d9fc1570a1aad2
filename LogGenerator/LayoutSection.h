#pragma once

#include "LogGenerator/Base.h"
#include "platform/system/Environment.h"

namespace kelvo {

/// A section that shows every record by the layout of its code and does nothing else. `Derived` says with `kTraceWord`
/// what each record writes to the log.
template <class Derived, const auto&... layouts>
class LayoutSection : public Section<Derived> {
public:
    static constexpr LogCode kLogCodes[] = {layouts.code...};

    using Section<Derived>::Section;
    void updateWithData(ByteView data, LogCode logCode) final {
        logLine(Level::Warning, Derived::kTraceWord);
        this->showOneOf(data, logCode, layouts...);
    }
};

}  // namespace kelvo
