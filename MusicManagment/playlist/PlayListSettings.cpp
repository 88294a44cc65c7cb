#include "CommonRUKTools/RWReg.h"
#include "MusicManagment/playlist/PlayList.h"

using namespace Qt::StringLiterals;

void TPlayList::LoadSettings(const TRWReg& settings) {
    const auto order = settings.ReadInteger(u"PlayOrder"_s);
    if (order && *order >= poDownwards && *order <= poStopAfterPlay)
        SetPlayOrder(static_cast<TPlayOrder>(*order));
    const auto scanTime = settings.ReadInteger(u"ScanTime"_s);
    if (scanTime && *scanTime >= 0) SetScanTime(*scanTime);
    if (const auto scan = settings.ReadBool(u"Scan"_s)) SetScan(*scan);
    if (const auto repeat = settings.ReadBool(u"RepeatAll"_s)) SetRepeatAll(*repeat);
    if (const auto copy = settings.ReadBool(u"CopyMp3sBeforePlay"_s)) SetCopyMp3sBeforePlay(*copy);
}

void TPlayList::SaveSettings(TRWReg& settings) const {
    settings.WriteInteger(u"PlayOrder"_s, playOrder_);
    settings.WriteBool(u"Scan"_s, scan_);
    settings.WriteInteger(u"ScanTime"_s, scanTime_);
    settings.WriteBool(u"RepeatAll"_s, repeatAll_);
    settings.WriteBool(u"CopyMp3sBeforePlay"_s, copyMp3sBeforePlay_);
}
