#pragma once

#include <cstdint>
#include <map>
#include <span>
#include <string>
#include <string_view>
#include <vector>

#include "LogGenerator/CodeDictionary.h"
#include "LogGenerator/LogCode.h"
#include "LogGenerator/ShowFields.h"
#include "platform/values/Bytes.h"
#include "platform/values/Value.h"

namespace kelvo {

/// Section name to section. The sections belong to the class index.
using ClassDictionary = std::map<std::string, Base*, std::less<>>;

/// One display section: decodes the records of a fixed set of log codes into its own part of the live display.
/// A record that does not fit (unknown code, too short) leaves the values shown before.
class Base {
public:
    virtual ~Base() = default;
    Base(const Base&) = delete;
    Base& operator=(const Base&) = delete;

    /// Binds the section to its part of the display: a dictionary of values or an array of rows, as the template has
    /// it. The state owns the display; a section without a part decodes into nothing.
    void updateSectionRef(Value displayPart);
    /// Decodes one packet, already without its prefix. `data` is borrowed for the call.
    virtual void updateWithData(ByteView data, LogCode logCode) = 0;
    /// The display name, which is also the section's key in the template.
    virtual std::string_view getSectionName() const = 0;
    virtual std::span<const LogCode> getLogCodeArray() const = 0;
    /// Subscribes to every code of `getLogCodeArray`.
    void updateLogCodeDict(CodeDictionary& codeDict);

    /// Both under ArrayLock, so that readers see the rows before, none, or the rows after. A null array is ignored.
    static void clearElementsInArray(const ArrayRef& array);
    static void replaceArray(const ArrayRef& array, std::vector<Value> with);

    /// A raw Ec/Io energy in dB.
    static std::int16_t lookUpECNO(std::uint32_t raw);

protected:
    Base() = default;

    /// The section's rows; null when the display part is not an array.
    const ArrayRef& list() const { return sectionRef.array(); }
    /// The section's values; null when the display part is not a dictionary.
    const DictionaryRef& values() const { return sectionRef.dictionary(); }

    /// Shows a record by its layout. False, and nothing changed, when the record is too short for it.
    template <std::size_t N>
    bool show(ByteView data, const RecordLayout<N>& layout) const {
        return showLayout(data, layout.size, layout.fields);
    }
    /// Shows a record by the layout of its code; a code of none of them is reported.
    template <std::size_t... N>
    void showOneOf(ByteView data, LogCode logCode, const RecordLayout<N>&... layouts) const {
        const bool known = ((logCode == layouts.code && (show(data, layouts), true)) || ...);
        if (!known) reportUnknown(logCode);
    }
    /// Takes a key off the screen.
    void hide(Key key) const {
        if (values()) values()->remove(key);
    }
    /// Writes "Received an unknown log message: %d".
    static void reportUnknown(LogCode logCode);

    Value sectionRef;

private:
    bool showLayout(ByteView data, std::size_t minimum, std::span<const Field> fields) const;
};

/// What every section shares: `Derived` names itself with `kSectionName` and its codes with `kLogCodes`, and is
/// registered under both as soon as it is made.
template <class Derived>
class Section : public Base {
public:
    Section(ClassDictionary& classDict, CodeDictionary& codeDict) {
        classDict[std::string(Derived::kSectionName)] = this;
        updateLogCodeDict(codeDict);
    }

    std::string_view getSectionName() const final { return Derived::kSectionName; }
    std::span<const LogCode> getLogCodeArray() const final { return Derived::kLogCodes; }
};

}  // namespace kelvo
