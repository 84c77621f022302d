// The read sequence of the results store.
#include "results/results_store.h"

std::string RowQuery(const std::string& id) {
    return "select * from results_store where id = '" + id + "'";
}

Ref<RecordSet> OpenStore(SQLiteDatabase& db, const std::string& statement) {
    Ref<FolderItem> file = GetFolderItem(kResultsStorePath, 1);
    if (file.IsNil() || !file->Exists()) {
        return nullptr;
    }
    db.DatabaseFile = file;
    if (!db.Connect()) {
        return nullptr;
    }
    Ref<RecordSet> rows = db.SQLSelect(statement);
    // An empty result is released with its last reference, without Close.
    if (rows.IsNil() || rows->Eof()) {
        return nullptr;
    }
    return rows;
}
