// Stand-in until the collection steps are written.
#include "workdb/CollectionRun.h"

namespace zorbin {

Status BuildAndCollectData(RunContext &)
{
    return Status::fault(QStringLiteral("איסוף הנתונים עדיין אינו זמין בגרסה זו."));
}

} // namespace zorbin
