// Lutris's game database, read through SQLite without ever writing to it.
#include <sqlite3.h>

#include "game/game_managers.h"
#include "platform/filesystem.h"

namespace kickvane::game {

std::optional<LutrisGameRow> ReadLutrisGame(const fs::path& database, std::string_view configName,
                                            std::string* problem) {
    if (!platform::IsRegularFile(database)) {
        *problem = "no database";
        return std::nullopt;
    }
    sqlite3* db = nullptr;
    // Read-only: Lutris may have it open; a busy database is waited for briefly, never locked
    // for writing.
    if (sqlite3_open_v2(database.c_str(), &db, SQLITE_OPEN_READONLY, nullptr) != SQLITE_OK) {
        *problem = db != nullptr ? sqlite3_errmsg(db) : "cannot open";
        sqlite3_close(db);
        return std::nullopt;
    }
    sqlite3_busy_timeout(db, 500);
    sqlite3_stmt* query = nullptr;
    std::optional<LutrisGameRow> row;
    if (sqlite3_prepare_v2(db, "SELECT id, slug, name FROM games WHERE configpath = ?1 LIMIT 1", -1,
                           &query, nullptr) != SQLITE_OK) {
        *problem = sqlite3_errmsg(db);
    } else {
        sqlite3_bind_text(query, 1, configName.data(), static_cast<int>(configName.size()),
                          SQLITE_TRANSIENT);
        const int step = sqlite3_step(query);
        if (step == SQLITE_ROW) {
            auto text = [&](int column) {
                const unsigned char* value = sqlite3_column_text(query, column);
                return value != nullptr ? std::string(reinterpret_cast<const char*>(value))
                                        : std::string();
            };
            row = LutrisGameRow{text(0), text(1), text(2)};
        } else {
            *problem = step == SQLITE_DONE ? "no such game" : sqlite3_errmsg(db);
        }
    }
    sqlite3_finalize(query);
    sqlite3_close(db);
    return row;
}

}  // namespace kickvane::game
