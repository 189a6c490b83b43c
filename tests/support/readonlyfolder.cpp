#include "support/readonlyfolder.h"

#include <QDir>
#include <QFile>

#ifdef Q_OS_WIN
#include <windows.h>
#include <aclapi.h>
#include <sddl.h>
#endif

namespace qmtest {

namespace {

#ifdef Q_OS_WIN
// Sets the folder's own access control list from a security descriptor text;
// "" puts back the list it inherits from its parent, as a new folder has.
bool setacl(const QString& path, const wchar_t* sddl)
{
    std::wstring name = QDir::toNativeSeparators(path).toStdWString();
    if (!*sddl) {
        ACL empty;
        if (!InitializeAcl(&empty, sizeof empty, ACL_REVISION))
            return false;
        return SetNamedSecurityInfoW(name.data(), SE_FILE_OBJECT,
                                     DACL_SECURITY_INFORMATION | UNPROTECTED_DACL_SECURITY_INFORMATION, nullptr,
                                     nullptr, &empty, nullptr) == ERROR_SUCCESS;
    }
    PSECURITY_DESCRIPTOR sd = nullptr;
    if (!ConvertStringSecurityDescriptorToSecurityDescriptorW(sddl, SDDL_REVISION_1, &sd, nullptr))
        return false;
    BOOL present = FALSE, defaulted = FALSE;
    PACL acl = nullptr;
    const bool ok = GetSecurityDescriptorDacl(sd, &present, &acl, &defaulted)
        && SetNamedSecurityInfoW(name.data(), SE_FILE_OBJECT,
                                 DACL_SECURITY_INFORMATION | PROTECTED_DACL_SECURITY_INFORMATION, nullptr, nullptr,
                                 acl, nullptr) == ERROR_SUCCESS;
    LocalFree(sd);
    return ok;
}
#endif

} // namespace

readonlyfolder::readonlyfolder(const QString& path) : path_(path)
{
#ifdef Q_OS_WIN
    // Everyone: denied adding files and folders and removing children (0x46)
    // of this folder, allowed everything else here and below.
    if (!setacl(path, L"D:P(D;;0x46;;;WD)(A;OICI;FA;;;WD)"))
        ineffective_ = QStringLiteral("the folder's access control list could not be set");
#else
    QFile::setPermissions(path, QFileDevice::ReadOwner | QFileDevice::ExeOwner);
#endif
    if (!ineffective_.isEmpty())
        return;
    QFile probe(QDir(path).filePath(QStringLiteral("probe.tmp")));
    if (probe.open(QIODevice::WriteOnly)) {
        probe.close();
        probe.remove();
#ifdef Q_OS_WIN
        if (GetProcAddress(GetModuleHandleW(L"ntdll.dll"), "wine_get_version"))
            ineffective_ = QStringLiteral("Wine does not enforce a folder's access control list");
        else
#endif
            ineffective_ = QStringLiteral("running with rights that ignore folder permissions");
    }
}

readonlyfolder::~readonlyfolder()
{
#ifdef Q_OS_WIN
    setacl(path_, L"");
#else
    QFile::setPermissions(path_, QFileDevice::ReadOwner | QFileDevice::WriteOwner | QFileDevice::ExeOwner);
#endif
}

} // namespace qmtest
