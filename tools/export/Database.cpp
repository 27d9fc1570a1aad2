#include "tools/export/Database.h"

#include <sqlite3.h>

#include <utility>

#include "tools/CommandFailure.h"

namespace kelvo {

void Database::Closer::operator()(sqlite3* handle) const { sqlite3_close(handle); }

void Database::Statement::Finalizer::operator()(sqlite3_stmt* statement) const { sqlite3_finalize(statement); }

Database::Database(std::string name, const std::string& file) : _name(std::move(name)) {
    sqlite3* handle = nullptr;
    const int status = sqlite3_open_v2(file.c_str(), &handle, SQLITE_OPEN_READWRITE, nullptr);
    _handle.reset(handle);
    if (status != SQLITE_OK) fail();
    run("PRAGMA journal_mode = OFF; PRAGMA synchronous = OFF; PRAGMA locking_mode = EXCLUSIVE");
}

void Database::run(const std::string& sql) {
    if (sqlite3_exec(_handle.get(), sql.c_str(), nullptr, nullptr, nullptr) != SQLITE_OK) fail();
}

void Database::close() {
    if (sqlite3_close(_handle.get()) != SQLITE_OK) fail();
    static_cast<void>(_handle.release());
}

void Database::fail() const {
    throw CommandFailure(_name + " cannot be written: " + (_handle ? sqlite3_errmsg(_handle.get()) : "no memory"));
}

Database::Statement::Statement(const Database& database, std::string_view sql) : _database(database) {
    sqlite3_stmt* statement = nullptr;
    const int status = sqlite3_prepare_v3(database._handle.get(), sql.data(), static_cast<int>(sql.size()),
                                          SQLITE_PREPARE_PERSISTENT, &statement, nullptr);
    _statement.reset(statement);
    if (status != SQLITE_OK) database.fail();
}

Database::Statement& Database::Statement::bind(int at, std::int64_t number) {
    if (sqlite3_bind_int64(_statement.get(), at, number) != SQLITE_OK) _database.fail();
    return *this;
}

Database::Statement& Database::Statement::bind(int at, double number) {
    if (sqlite3_bind_double(_statement.get(), at, number) != SQLITE_OK) _database.fail();
    return *this;
}

Database::Statement& Database::Statement::bind(int at, std::string_view text) {
    const char* data = text.data() != nullptr ? text.data() : "";  // null would be NULL
    const int status = sqlite3_bind_text64(_statement.get(), at, data, text.size(), SQLITE_STATIC, SQLITE_UTF8);
    if (status != SQLITE_OK) _database.fail();
    return *this;
}

bool Database::Statement::step() {
    const int status = sqlite3_step(_statement.get());
    if (status == SQLITE_ROW) return true;
    if (status != SQLITE_DONE) _database.fail();
    reset();
    return false;
}

void Database::Statement::reset() {
    sqlite3_reset(_statement.get());
    sqlite3_clear_bindings(_statement.get());
}

bool Database::Statement::isNull(int column) const {
    return sqlite3_column_type(_statement.get(), column) == SQLITE_NULL;
}

std::int64_t Database::Statement::integer(int column) const { return sqlite3_column_int64(_statement.get(), column); }

std::string Database::Statement::text(int column) const {
    const auto* text = reinterpret_cast<const char*>(sqlite3_column_text(_statement.get(), column));
    return text != nullptr ? text : std::string();
}

}  // namespace kelvo
