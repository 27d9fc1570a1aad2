#pragma once

#include <string>
#include <string_view>

#include "platform/values/Value.h"

namespace kelvo {

/// Rows of a list change their positions; what a row is about does not. These tell a cell, channel or context from the
/// others of its list by the values that name it.

/// What people call the value of `key` in front of it ("PCI" for "Physical Cell ID"), when that value names something
/// and measures nothing; null for every other key.
const std::string* shortNameOf(std::string_view key);

/// Whether the value of `key` names an area or a network: a number to write, and none to reckon with.
bool namesAnArea(std::string_view key);

/// Whether the value of `key`, outside of lists, names the serving cell; the smaller the better people know it by that
/// name. 0 when it does not.
int rankAsServingCell(std::string_view key);

/// "PCI 301", "ARFCN 40, BSIC 16", "LTE, EARFCN 1300, cell 17": what names the row's subject, in the row's order; empty
/// when nothing does.
std::string identityOf(const Dictionary& row);

/// The channel that all cells of the list at `path` are on, as a part of their names ("EARFCN 1300"), where the screens
/// tell it beside the list; else empty.
std::string channelOfList(const Value& display, std::string_view path);

}  // namespace kelvo
