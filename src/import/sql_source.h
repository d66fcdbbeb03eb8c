#pragma once

#include <optional>

#include "platform/context.h"
#include "platform/list_entry.h"

// The host package's SQL Server database, reached over ODBC with the connection text of the
// four connection parameters and the driver setting: the price lists (OPLN) and the carriers
// (OSHP), the two lists the component reads from it. Each read opens the connection, reads to
// the end and closes. A failure of any kind throws QuietFailure with the driver's words: the
// windows pass over it (and log it), the command line tells it.
namespace etq {

// "SELECT ListNum, ListName FROM OPLN": one entry per list whose trimmed name is not empty, in
// the order the database gives them, showing the name and holding the number. Nothing when the
// table has no rows at all, so that a list already shown stays.
std::optional<EntryList> ReadPriceLists(const ConnParams& params);

// "SELECT TrnspCode, TrnspName FROM OSHP Order By TrnspName": one entry per carrier whose
// trimmed name is not empty, showing the name and holding the code. Nothing when the table has
// no rows at all.
std::optional<EntryList> ReadCarriers(const ConnParams& params);

// Opens the connection of the parameters and closes it again.
void TestSqlServerConnection(const ConnParams& params);

}  // namespace etq
