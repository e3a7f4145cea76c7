// The user-workflow database over SQLite: statements, schema migrations, transactions.
#include "workflow/Database.h"

#include <vector>

namespace ConfigurationService {
namespace Workflow {
namespace {

// Schema migrations in order; version N is reached by applying the first N. A migration is
// never changed once released: a change of the schema is a new entry.
const std::vector<const char*>& migrations() {
    static const std::vector<const char*> list = {
        // 1: users, the node tree, exams in folders, contact names, preferences.
        "CREATE TABLE users ("
        "  user_id TEXT PRIMARY KEY, user_name TEXT NOT NULL DEFAULT '',"
        "  type TEXT NOT NULL DEFAULT '', inbox_id TEXT NOT NULL DEFAULT '',"
        "  master_folder_id TEXT NOT NULL DEFAULT '', on_call INTEGER NOT NULL DEFAULT 0,"
        "  logged_in INTEGER NOT NULL DEFAULT 0, login_time INTEGER NOT NULL DEFAULT 0);"
        "CREATE TABLE nodes ("
        "  id TEXT PRIMARY KEY, name TEXT NOT NULL DEFAULT '', user_id TEXT NOT NULL,"
        "  parent_id TEXT REFERENCES nodes(id) ON DELETE CASCADE, type INTEGER NOT NULL,"
        "  shared INTEGER NOT NULL DEFAULT 0, opaque TEXT NOT NULL DEFAULT '',"
        "  modified INTEGER NOT NULL);"
        "CREATE INDEX nodes_by_parent ON nodes(parent_id, type, modified);"
        "CREATE INDEX nodes_by_owner ON nodes(user_id, type);"
        "CREATE TABLE exam_folders ("
        "  exam_key TEXT NOT NULL, folder_id TEXT NOT NULL REFERENCES nodes(id) ON DELETE CASCADE,"
        "  PRIMARY KEY (exam_key, folder_id));"
        "CREATE INDEX exam_folders_by_folder ON exam_folders(folder_id);"
        "CREATE TABLE contact_names ("
        "  user_id TEXT PRIMARY KEY, family_name TEXT NOT NULL DEFAULT '',"
        "  given_name TEXT NOT NULL DEFAULT '', middle_name TEXT NOT NULL DEFAULT '',"
        "  honorific_prefix TEXT NOT NULL DEFAULT '', honorific_suffix TEXT NOT NULL DEFAULT '');"
        "CREATE TABLE preferences ("
        "  user_id TEXT NOT NULL, path TEXT NOT NULL, data TEXT NOT NULL,"
        "  PRIMARY KEY (user_id, path));",
    };
    return list;
}

void check(sqlite3* db, int result, const char* what) {
    if (result != SQLITE_OK && result != SQLITE_DONE && result != SQLITE_ROW) {
        throw DatabaseError(std::string("workflow database: ") + what + ": " + sqlite3_errmsg(db));
    }
}

}  // namespace

Statement::Statement(sqlite3* db, const char* sql) : m_db(db) {
    check(db, sqlite3_prepare_v2(db, sql, -1, &m_statement, nullptr), "prepare");
}

Statement::~Statement() {
    sqlite3_finalize(m_statement);
}

Statement& Statement::bind(int index, const std::string& text) {
    check(m_db,
          sqlite3_bind_text(m_statement, index, text.data(), static_cast<int>(text.size()),
                            SQLITE_TRANSIENT),
          "bind");
    return *this;
}

Statement& Statement::bind(int index, std::int64_t value) {
    check(m_db, sqlite3_bind_int64(m_statement, index, value), "bind");
    return *this;
}

bool Statement::step() {
    const int result = sqlite3_step(m_statement);
    check(m_db, result, "step");
    return result == SQLITE_ROW;
}

void Statement::run() {
    while (step()) {
    }
}

std::string Statement::text(int column) const {
    const auto* text = reinterpret_cast<const char*>(sqlite3_column_text(m_statement, column));
    return text == nullptr
               ? std::string()
               : std::string(text,
                             static_cast<std::size_t>(sqlite3_column_bytes(m_statement, column)));
}

std::int64_t Statement::integer(int column) const {
    return sqlite3_column_int64(m_statement, column);
}

void Statement::reset() {
    sqlite3_reset(m_statement);
    sqlite3_clear_bindings(m_statement);
}

int Database::newestVersion() {
    return static_cast<int>(migrations().size());
}

Database::Database(const std::string& path) {
    const int result =
        sqlite3_open_v2(path.c_str(), &m_db,
                        SQLITE_OPEN_READWRITE | SQLITE_OPEN_CREATE | SQLITE_OPEN_NOMUTEX, nullptr);
    if (result != SQLITE_OK) {
        const std::string message = m_db ? sqlite3_errmsg(m_db) : "out of memory";
        sqlite3_close(m_db);
        throw DatabaseError("cannot open the workflow database " + path + ": " + message);
    }
    try {
        exec("PRAGMA journal_mode=WAL");
        exec("PRAGMA synchronous=FULL");
        exec("PRAGMA foreign_keys=ON");
        sqlite3_busy_timeout(m_db, 10000);
        migrate();
    } catch (...) {
        sqlite3_close(m_db);
        throw;
    }
}

Database::~Database() {
    for (auto& entry : m_statements) {
        delete entry.second;
    }
    sqlite3_close(m_db);
}

void Database::exec(const char* sql) {
    char* error = nullptr;
    if (sqlite3_exec(m_db, sql, nullptr, nullptr, &error) != SQLITE_OK) {
        const std::string message = error ? error : sqlite3_errmsg(m_db);
        sqlite3_free(error);
        throw DatabaseError("workflow database: " + message);
    }
}

Statement& Database::prepare(const char* sql) {
    Statement*& statement = m_statements[sql];
    if (statement == nullptr) {
        statement = new Statement(m_db, sql);
    }
    statement->reset();
    return *statement;
}

int Database::version() {
    Statement& statement = prepare("PRAGMA user_version");
    statement.step();
    const int version = static_cast<int>(statement.integer(0));
    statement.reset();
    return version;
}

std::string Database::integrityCheck() {
    Statement& statement = prepare("PRAGMA integrity_check");
    std::string report;
    while (statement.step()) {
        report += (report.empty() ? "" : "; ") + statement.text(0);
    }
    return report;
}

void Database::migrate() {
    const int current = version();
    if (current > newestVersion()) {
        throw DatabaseError("the workflow database has schema version " + std::to_string(current) +
                            ", newer than this service knows (" + std::to_string(newestVersion()) +
                            ")");
    }
    for (int next = current + 1; next <= newestVersion(); ++next) {
        Transaction transaction(*this);
        exec(migrations()[static_cast<std::size_t>(next - 1)]);
        exec(("PRAGMA user_version=" + std::to_string(next)).c_str());
        transaction.commit();
    }
}

Transaction::Transaction(Database& db) : m_db(db) {
    m_db.exec("BEGIN IMMEDIATE");
}

Transaction::~Transaction() {
    if (m_open) {
        try {
            m_db.exec("ROLLBACK");
        } catch (const std::exception&) {
            // Nothing more to undo: SQLite rolled back already.
        }
    }
}

void Transaction::commit() {
    m_db.exec("COMMIT");
    m_open = false;
}

}  // namespace Workflow
}  // namespace ConfigurationService
