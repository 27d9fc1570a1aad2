#pragma once

#include <memory>
#include <string>

#include "LogGenerator/ClassIndex.h"
#include "LogGenerator/OSKLogGenerator.h"

namespace kelvo {

/// The generator of the technologies whose screens are described by a template and filled by sections: loads the
/// template once, binds every section to its part of the display, and routes each packet to the sections that
/// subscribed to its code. Subclasses choose the template's name and the class index.
class OSKLogGenerator2 : public OSKLogGenerator {
public:
    /// `pListName` is the base name of a template resource of type "plist". Without a class index the generator stays
    /// half built, which no log line tells: it has no template, decodes nothing and only collects the raw records.
    OSKLogGenerator2(std::string pListName, std::unique_ptr<ClassIndex> cIndexObj);
    ~OSKLogGenerator2() override;

    void updateState(Dictionary& state, ByteView data) override;
    Value generateLogUsingState(Dictionary& state) override;
    DictionaryRef getStartCommand() override;

    /// Routes one message to its subscribers; a message that is no packet is dropped.
    void updateWithData(ByteView data);
    /// The live copy of a template node, with the sections in it bound to their parts: a key that names a section
    /// inside another section's part is not for templates. None for anything but dictionaries, arrays and strings; a
    /// parent of such a node throws std::invalid_argument.
    Value processTemplate(const Value& node);
    /// Checks that a processed node holds nothing but dictionaries, arrays and strings.
    void printDict(const Value& node) const;
    /// Makes sure that the state has a display and the sections their parts of it, and returns the display that was
    /// there before: none when this call is what builds it. The reference holds until the state changes.
    const Value& getDisplayFromState(Dictionary& state);

private:
    bool loadTemplate(Dictionary& state) const;
    void buildDisplay(Dictionary& state);
    void adoptDisplay(const Value& display);
    void bindSection(std::string_view name, const Value& displayPart) const;

    std::string pListName;
    std::unique_ptr<ClassIndex> cIndex;
    Value _boundDisplay;  // the display that this generator has built or adopted
};

}  // namespace kelvo
