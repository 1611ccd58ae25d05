// One call of a stored procedure: its parameters as the server declares them, their values, its row set and outputs.
#pragma once

#include <memory>
#include <vector>

#include "varnex3/core/RowSet.h"
#include "varnex3/services/DatabaseConnection.h"
#include "varnex3/services/ProcedureParameter.h"

namespace varnex3 {

class ProcedureCall
{
public:
    // Asks the server for the parameters. A procedure that it does not know has none; Execute then fails.
    ProcedureCall(DatabaseConnection& connection_, TextView name_);

    const std::vector<ProcedureParameter>& Parameters() const { return parameters; }

    // Gives the texts to the input parameters, in the server's order, as ConvertedText says. Texts that are left over
    // are ignored; parameters that are left over keep no value.
    void GiveTexts(const std::vector<TextView>& texts);

    // Runs the procedure and reads everything that it answers: the first row set, or one that is not open when there
    // was none, and the outputs. An input without a value takes the procedure's
    // default; through FreeTDS, which cannot ask for it, null is sent instead.
    std::shared_ptr<RowSet> Execute(RowSet::Form form);

    // A parameter by name, in any letter case; raises kItemNotFound when there is none. After Execute it has what came
    // back.
    const ProcedureParameter& Parameter(TextView parameter) const;

private:
    struct Slot;

    Text CallText() const;
    void Bind(const OdbcHandle& statement, std::vector<Slot>& slots);
    std::shared_ptr<RowSet> ReadResults(const OdbcHandle& statement, RowSet::Form form);
    bool TakeOutputsOfMariaDB(const std::vector<Text>& columns, const std::vector<RowSet::Row>& rows);

    DatabaseConnection& connection;
    Text name;
    std::vector<ProcedureParameter> parameters;
    bool hasOutputs = false;
};

} // namespace varnex3
