#pragma once

#include <QString>

namespace zorbin {

// How a run ended, as the control decided it; the front end maps it to what it shows or to an
// exit status. The user has already been told whatever a message says.
struct RunOutcome
{
    enum class Ending {
        Declined, // the user did not confirm, or another run was in progress: nothing was done
        Complete, // everything was collected and written, and the result shown
        Partial,  // a collection step failed (its text in `message`); the later steps did not run
                  // and the output, if any, holds what was collected before
        Stopped,  // a stop request cut the collection or the writing short; what was written is shown
        NoItems,  // the catalog query had no rows: nothing was written or shown
        Failed,   // a fault ended the run (its text in `message`)
    };

    Ending ending = Ending::Declined;
    QString file;    // what was shown (or, when showing failed, written); empty when nothing was
    QString message; // the fault's or the failed step's text
};

} // namespace zorbin
