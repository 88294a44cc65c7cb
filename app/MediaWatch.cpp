#include "app/MediaWatch.h"

#include "CommonRUKTools/CommandRunner.h"
#include "CommonRUKTools/Volumes.h"
#include "MusicManagment/database/MusicManagment.h"

MediaWatch::MediaWatch(TMusicDatabase& database) {
    changes_ = CurrentVolumes().Changed.Subscribe([&database] {
        database.Events().MediaChanged.Tell();
        // During a run songs keep their places; whoever places one afterwards looks again.
        if (database.SortType() == stCacheType && !database.ProgressRunning() && !database.Busy())
            RunCommand([&database] { database.EnsureSorted(); });
    });
    CurrentVolumes().Watch();
}
