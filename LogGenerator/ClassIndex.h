#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "LogGenerator/Base.h"

namespace kelvo {

/// All sections of one technology, by name and by log code. A technology's subclass holds the sections as members, in
/// the order in which they register.
class ClassIndex {
public:
    ClassIndex() = default;
    virtual ~ClassIndex();
    ClassIndex(const ClassIndex&) = delete;
    ClassIndex& operator=(const ClassIndex&) = delete;

    /// The section called `name`; null when there is none.
    Base* getClass(std::string_view name) const;
    /// The sections subscribed to `code`, in order; null when there are none.
    const CodeDictionary::Subscribers* getSubscribers(LogCode code) const { return codeDictionary.find(code); }
    /// Writes two diagnostic lines about the section dictionary.
    void status() const;
    /// Every subscribed log code, in the order of first subscriptions.
    const std::vector<LogCode>& getAllLogCodes() const { return codeDictionary.allCodes(); }
    /// Every section name.
    std::vector<std::string_view> getAllNames() const;

protected:
    ClassDictionary classDict;
    CodeDictionary codeDictionary;
};

}  // namespace kelvo
