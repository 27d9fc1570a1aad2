#pragma once

#include <memory>
#include <string>
#include <string_view>

struct sqlite3;
struct sqlite3_stmt;

namespace kelvo {

/// A new SQLite database that nobody else has open: written without a journal and without waiting for the disk, since
/// it is given its name when it is whole. Moves, never copies; one thread. What goes wrong ends the command
/// (CommandFailure), which names the database by `name`.
class Database {
public:
    Database(std::string name, const std::string& file);

    /// Carries out statements that give nothing.
    void run(const std::string& sql);
    /// Everything is in the file afterwards; nothing else may be called.
    void close();

    class Statement;

private:
    struct Closer {
        void operator()(sqlite3* handle) const;
    };
    [[noreturn]] void fail() const;

    std::string _name;
    std::unique_ptr<sqlite3, Closer> _handle;
};

/// A statement that is carried out again and again. It goes before its database is closed.
class Database::Statement {
public:
    Statement(const Database& database, std::string_view sql);

    // The parameters from 1 on; those that nobody binds are NULL.
    Statement& bind(int at, std::int64_t number);
    Statement& bind(int at, double number);
    Statement& bind(int at, std::string_view text);  ///< borrowed until `step` says that there is no row
    /// True when there is a row; else it is over and everything is unbound.
    bool step();
    /// Ends it before its last row.
    void reset();
    bool isNull(int column) const;
    std::int64_t integer(int column) const;
    std::string text(int column) const;

private:
    struct Finalizer {
        void operator()(sqlite3_stmt* statement) const;
    };
    const Database& _database;
    std::unique_ptr<sqlite3_stmt, Finalizer> _statement;
};

}  // namespace kelvo
