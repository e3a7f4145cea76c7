// Database: one SQLite connection to the user-workflow database: opened in WAL mode with full
// synchronisation (a committed transaction survives a crash of the process or the machine),
// foreign keys enforced, the schema brought to the newest version by numbered migrations
// (PRAGMA user_version), and prepared statements kept for reuse. Not thread-safe: its owner
// (WorkflowStore) serialises every use.
#pragma once

#include <sqlite3.h>

#include <cstdint>
#include <map>
#include <stdexcept>
#include <string>

namespace ConfigurationService {
namespace Workflow {

// A failure of the database itself (not of a request).
class DatabaseError : public std::runtime_error {
public:
    using std::runtime_error::runtime_error;
};

// One prepared statement; reset and unbound each time it is handed out.
class Statement {
public:
    Statement(sqlite3* db, const char* sql);
    ~Statement();
    Statement(const Statement&) = delete;
    Statement& operator=(const Statement&) = delete;

    // Binds parameter index (from 1).
    Statement& bind(int index, const std::string& text);
    Statement& bind(int index, std::int64_t value);
    // Steps once: true while a row is there; throws DatabaseError on failure.
    bool step();
    // Runs to the end (a statement without rows).
    void run();
    // Column values of the current row.
    std::string text(int column) const;
    std::int64_t integer(int column) const;
    // Makes the statement ready for new parameters.
    void reset();

private:
    sqlite3* m_db;
    sqlite3_stmt* m_statement = nullptr;
};

class Database {
public:
    // The newest schema version.
    static int newestVersion();

    // Opens (creating) the database file and migrates it; throws DatabaseError.
    explicit Database(const std::string& path);
    ~Database();
    Database(const Database&) = delete;
    Database& operator=(const Database&) = delete;

    // Runs SQL without parameters or rows.
    void exec(const char* sql);
    // The cached statement of sql (a string literal: cached by address), reset.
    Statement& prepare(const char* sql);
    // The schema version the file has.
    int version();
    // "ok", or what SQLite's integrity check reports.
    std::string integrityCheck();

private:
    void migrate();

    sqlite3* m_db = nullptr;
    std::map<const char*, Statement*> m_statements;
};

// A write transaction: BEGIN IMMEDIATE at construction, commit() makes it durable, the
// destructor rolls back what was not committed.
class Transaction {
public:
    explicit Transaction(Database& db);
    ~Transaction();
    Transaction(const Transaction&) = delete;
    Transaction& operator=(const Transaction&) = delete;

    // Commits; throws DatabaseError when it cannot.
    void commit();

private:
    Database& m_db;
    bool m_open = true;
};

}  // namespace Workflow
}  // namespace ConfigurationService
