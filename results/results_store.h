// The read side of the results store that the verifier plug-in writes.
#pragma once

#include <string>

#include "platform/core/database.h"

// The one location of the store, in shell form.
inline constexpr const char* kResultsStorePath =
    "/Library/Application\\ Support/Tamsorel/results.db";
inline constexpr const char* kListQuery = "select * from results_store";

// The row query: the id goes in as it stands, between quotes.
std::string RowQuery(const std::string& id);

// Resolves the store, connects `db` to it and runs `statement`. Nil when the read ends early:
// no item, no file, no connection, a failed statement, or no row. The caller closes the
// record set it gets, and then the database in any case.
Ref<RecordSet> OpenStore(SQLiteDatabase& db, const std::string& statement);
