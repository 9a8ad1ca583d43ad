#include "components/photo/ies/photoWebIES.h"

namespace OvPhotometrics {

void iesWebRecordInit(IesWebRecord& rec, int nthetas, int npsis, PhotoWebSymmetry symmetry, bool psiTruncated,
                      bool loaded, const wchar_t* name, const wchar_t* tiltFile, const wchar_t* tiltPath) {
    photoWebRecordInit(rec, nthetas, npsis, symmetry, psiTruncated, loaded, name);
    rec.tiltFile = tiltFile ? tiltFile : L"";
    rec.tiltPath = tiltPath ? tiltPath : L"";
}

bool PhotoWebIES::installIesRecord(const IesWebRecord& rec) {
    std::wstring tiltFile = rec.tiltFile;
    std::wstring tiltPath = rec.tiltPath;
    if (!photoWebInstall(*this, rec)) return false;
    _tiltFile = std::move(tiltFile);
    _tiltPath = std::move(tiltPath);
    return true;
}

RnEnum::Action PhotoWebIES::enumerateFiles(Ov::RnEnumerator<const wchar_t*>& visitor) const {
    if (!_tiltPath.empty())
        if (const auto action = visitor.visit(_tiltPath.c_str()); action != RnEnum::goOn) return action;
    return visitor.finish();
}

}  // namespace OvPhotometrics
