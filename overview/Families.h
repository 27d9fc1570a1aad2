#pragma once

#include <fmt/format.h>

#include "model/LevelGrades.h"
#include "overview/Bands.h"
#include "overview/Observation.h"
#include "platform/values/Array.h"
#include "platform/values/Dictionary.h"

/// What each family's screens say, and the words that the families share.
namespace kelvo::overview {

Observation observeCdma(const Value& display);
Observation observeGsmUmts(const Value& display);
Observation observeIfx(const Value& display);
Observation observeLte(const Value& display);
Observation observeUtran(const Value& display);

/// Appends a fact that has a text.
void add(std::vector<Fact>& facts, std::string_view name, std::string text);
/// The same of a value that may be a number.
void addRate(std::vector<Fact>& rates, std::string_view name, const Screens& screens, std::string_view path);
/// The measure under that name; none when the screens have no number there.
std::optional<Measure> measure(std::string_view name, std::optional<Figure> figure,
                               std::optional<Graded> graded = std::nullopt);
/// "3" and, as a fact, its MHz: "3 (1,815.0 MHz down, 1,720.0 MHz up)"; of several bands "DCS 1800 or PCS 1900".
void addBand(Observation& seen, const std::vector<BandChannel>& bands);
/// The operator as PLMN, of three and of two or three digits: "001-01".
void addNetwork(Observation& seen, std::string country, std::string network);
/// A UMTS cell's identity with its parts: "44041665 (RNC 672, cell 1)", 12 and 16 bits of 3GPP TS 25.331, 10.3.2.2.
void addRncAndCell(Observation& seen, std::int64_t identity);
/// The parts of a BSIC of three bits each, 3GPP TS 23.003, 4.3.2: "NCC 5, BCC 2".
void addColorCodes(Observation& seen, std::int64_t bsic);
/// The contexts of a screen "PDP Context Info", which several families have.
void addContexts(Observation& seen, const Value& contexts);
/// "EARFCN 1300, PCI 257"; empty when one of the two is.
std::string identity(std::string_view channel, std::string_view cell);
/// The rows of a list, none when there is none.
std::vector<Value> rowsOf(const Value& list);
/// "PCI 257"; empty without a number.
std::string named(std::string_view name, const std::string& number);

}  // namespace kelvo::overview
