// A connection to a database.
#pragma once

#include <chrono>
#include <memory>

#include "varnex3/services/Odbc.h"

namespace varnex3 {

// How long the library waits for a login.
inline constexpr std::chrono::seconds kLoginTimeout{2};

class DatabaseConnection
{
public:
    // Precondition: there is a driver manager.
    DatabaseConnection();
    ~DatabaseConnection();
    DatabaseConnection(const DatabaseConnection&) = delete;
    DatabaseConnection& operator=(const DatabaseConnection&) = delete;

    // Raises kConnectionFailed with the driver's reason. A server that is silent is given up after the login time-out.
    void Open(const Text& connectionString, std::chrono::seconds loginTimeout);

    // Whether it was opened and is not known to be broken. A connection that broke while nobody used it counts as open
    // until it is used.
    bool IsOpen() const;

    // How long a command may take; no limit before it is set.
    void LimitCommands(std::chrono::seconds limit) { commandTimeout = limit; }

    const OdbcFunctions& Functions() const { return odbc; }

    // A new statement, limited as commands are.
    std::unique_ptr<OdbcHandle> NewStatement() const;

    // Raises what a function said of a statement, unless it succeeded. What the driver only informs of, and that there
    // is nothing more, is success. A failure that broke the connection closes it.
    void Require(SQLRETURN result, const OdbcHandle& statement);

    // u"MariaDB", u"Microsoft SQL Server".
    const Text& ServerProduct() const { return serverProduct; }

private:
    const OdbcFunctions& odbc;
    OdbcHandle environment;
    OdbcHandle connection;
    Text serverProduct;
    std::chrono::seconds commandTimeout{0};
    bool isOpened = false;
    bool isBroken = false;
};

} // namespace varnex3
