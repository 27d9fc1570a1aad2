#include "tools/QuietDecoder.h"

#include "LogGenerator/Factory.h"

namespace kelvo {
namespace {

Environment silent() {
    Environment environment = Environment::current();
    environment.log = nullptr;
    return environment;
}

}  // namespace

QuietDecoder::QuietDecoder(Technology technology)
    : _silence(silent()),
      _generator(generatorFromTechnology(namesOf(technology).identifier)),
      _state(Dictionary::make()) {
    _generator->limitRawLog(0);
}

}  // namespace kelvo
