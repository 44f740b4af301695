#pragma once

#include "console/ExitStatus.h"
#include "fleet/ServerStore.h"
#include "query/Database.h"
#include "storing/ServerQuestions.h"

namespace pallax {

/// Adds what the questions need of a server: the tables `field` and `recordings`. The server is
/// asked when a query reads them.
void addServerTables(Database& database, ServerStore& store, const StoreAskOptions& options);

/// Adds the tables of a question and gives its query.
std::string addServerQuestion(Database& database, ServerStore& store,
                              const StoreAskOptions& options,
                              const std::vector<JudgedLevel>& levels, const AskedTime& time);

/// Sends a query of the user to a server and writes the rows to standard output. Wrong usage if it
/// is a wrong query.
ExitStatus askServer(ServerStore& store, const StoreAskOptions& options);

/// How long to wait for a server that answers a question.
Patience patienceOf(const StoreAskOptions& options);

} // namespace pallax
