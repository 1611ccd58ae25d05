// The workshop's database: one connection a thread, and one way to use it.
//
// Which database is read from the host's settings (ConnectionSettings.h). Where none can be reached nothing is raised:
// there are no rows. No function waits long for a server that is not there: a login takes two seconds at most, to look
// up a host or a named instance one second each. After an attempt that failed slowly (over 250 ms), this thread does
// not try the same connection string again for 30 seconds, unless it is asked to reconnect. A command may take 120
// seconds.
//
// Records ask for reference sets whenever they are made. Where a set found no database, this thread's sets of the next
// second are empty at once, unless DBConnect or DBExecSP was called since.
//
// Nothing is shared between threads and nothing is locked.
#pragma once

#include <chrono>
#include <cstdint>
#include <memory>
#include <optional>

#include "varnex3/core/ReferenceSet.h"
#include "varnex3/core/RowSet.h"
#include "varnex3/services/ConnectionSettings.h"
#include "varnex3/services/ProcedureParameter.h"

namespace varnex3 {

// What a stored procedure says with a negative @ErrNo; the description is its @ErrMsg.
inline constexpr ErrorNumber kProcedureFailed{30010};

// Reads the settings, and opens this thread's connection anew. Whether it is open; nothing is raised.
bool DBConnect();

// The same unless the connection is open already.
bool DBIsConnected();

// The value of a parameter; Empty for null and for no parameter.
Variant DBParamValue(const ProcedureParameter* parameter);

// Runs a stored procedure and gives its row set; nullptr when there is no connection.
//
// sParams has the values of its input parameters, separated by tabs, in the order in which the server declares them;
// each is converted to the declared type as ConvertedText says. Values too many are ignored, inputs without one take
// the procedure's default (null through FreeTDS). bReconnect drops the connection and connects anew; bUpdatable gives a
// row set in its updatable form.
//
// lID receives the output @ID, null as 0: when the row set has rows, and when there was none and @ErrNo is not
// negative. A set without rows leaves it. A procedure without row set gives a set that is not open.
//
// Raises kProcedureFailed for a negative @ErrNo without a row set; kItemNotFound for a procedure without @ID, @ErrNo or
// @ErrMsg where it is read; kCallFailed for what the server refuses, an unknown procedure too; Overflow and
// TypeMismatch for values that do not convert. The source is modDBAccess.DBExecSP.
std::shared_ptr<RowSet> DBExecSP(TextView sProcName, TextView sParams, std::int32_t& lID, const bool& bReconnect,
                                 const bool& bUpdatable);

// Why this thread's last attempt to connect failed, and how long it took; nothing when it succeeded or there was none.
struct ConnectFailure
{
    Text reason; // without the password
    std::chrono::milliseconds duration{0};
};
std::optional<ConnectFailure> LastConnectFailure();

} // namespace varnex3
