#pragma once

#include "common/Status.h"

#include <QString>

namespace zorbin {

// Why the working database refused a write.
enum class Refusal {
    None,         // nothing was refused
    DuplicateKey, // the table already holds a row with that key (letter case aside)
    TooLong,      // a text longer than its column allows
    WrongKind,    // a value of the wrong kind for its column, such as a text for a number
    Other,        // anything else: the file, the disk, the statement itself
};

// The outcome of a statement that writes. A refusal carries a description for the user: in
// Hebrew for the refusals the schema makes, in the engine's words for the rest.
class [[nodiscard]] WriteOutcome
{
public:
    WriteOutcome() = default; // written
    static WriteOutcome refused(Refusal refusal, QString description)
    {
        WriteOutcome outcome;
        outcome.m_refusal = refusal;
        outcome.m_description = std::move(description);
        return outcome;
    }
    // Classifies an error of the SQLite engine by its extended result code and message.
    static WriteOutcome fromEngine(int extendedCode, const QString &engineMessage);

    bool isOk() const { return m_refusal == Refusal::None; }
    explicit operator bool() const { return isOk(); }
    Refusal refusal() const { return m_refusal; }
    bool isDuplicateKey() const { return m_refusal == Refusal::DuplicateKey; }
    const QString &description() const { return m_description; }
    Status status() const { return isOk() ? Status::ok() : Status::fault(m_description); }

private:
    Refusal m_refusal = Refusal::None;
    QString m_description;
};

} // namespace zorbin
