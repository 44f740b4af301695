#pragma once

#include "sources/modem/BusCall.h"

#include <functional>
#include <string>
#include <string_view>

namespace pallax {

class ModemObjects;

/// Asks a modem for its cells, and waits for the answer.
using AskForCells = std::function<BusReply(const std::string& path)>;

/// A table with a line for each modem: index, model, state, operator, and what it can tell. Modems
/// that are enabled are asked for their cells.
std::string modemList(const ModemObjects& objects, const AskForCells& askForCells);

/// That the wanted modem is not there (see ModemChoice), and which ones are.
std::string missingModemSentence(std::string_view wanted, const ModemObjects& objects);

/// A policy of the system bus with which every user may ask for cells.
std::string_view cellPolicy();

} // namespace pallax
