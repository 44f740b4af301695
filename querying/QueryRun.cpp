#include "querying/QueryRun.h"

#include "console/Output.h"
#include "query/QueryErrorText.h"
#include "querying/Interrupt.h"

namespace pallax {

ExitStatus QueryRun::run(const std::string& text, RowFormat format) {
    const Interrupt interrupt(_request.isInterruptible ? Interrupt::Watched::Yes
                                                       : Interrupt::Watched::No);
    const Time start = _seams.clock.now();
    _stopped.clear();
    _database.setMayContinue([this, &interrupt, start] {
        _seams.waiting();
        if (interrupt.hasCome()) {
            _stopped = "The query was stopped.";
        } else if (_request.most && _seams.clock.now() - start >= *_request.most) {
            _stopped = "The query was stopped after its time (--timeout).";
        }
        return _stopped.empty();
    });
    auto query = _database.prepare(text);
    ExitStatus status = kExitWrongUsage;
    if (query) {
        Query running = std::move(query).value();
        status = write(running, format);
    } else {
        _seams.tell(queryErrorText(query.error(), text, _database.names()));
    }
    _database.setMayContinue({});
    return status;
}

ExitStatus QueryRun::write(Query& query, RowFormat format) {
    RowWriter writer(format, query.columns(), _seams.output);
    bool hasRows = false;
    while (true) {
        auto row = query.next();
        if (!row) {
            if (hasRows) {
                writer.finish();
            }
            _seams.tell(_stopped.empty() ? row.error().sentence : _stopped);
            return kExitFailure;
        }
        std::optional<std::vector<QueryValue>> values = std::move(row).value();
        if (!values) {
            writer.finish();
            return kExitSuccess;
        }
        writer.write(*std::move(values));
        hasRows = true;
    }
}

} // namespace pallax
