#include "platform/ReportingSettingsStore.h"

#include "platform/Dialogs.h"

#include <utility>

ReportingSettingsStore::ReportingSettingsStore(SettingsStore& store, Dialogs& dialogs,
                                               QString location)
    : m_store(store), m_dialogs(dialogs), m_location(std::move(location)) {}

QString ReportingSettingsStore::GetSetting(const QString& section, const QString& key,
                                           const QString& def) const {
    return m_store.GetSetting(section, key, def);
}

bool ReportingSettingsStore::SaveSetting(const QString& section, const QString& key,
                                         const QString& value) {
    return reportFailure(m_store.SaveSetting(section, key, value));
}

bool ReportingSettingsStore::DeleteSetting(const QString& section, const QString& key) {
    return reportFailure(m_store.DeleteSetting(section, key));
}

bool ReportingSettingsStore::reportFailure(bool written) {
    if (written) {
        m_reported = false;
        return true;
    }
    // One box for a run of failures: closing the program alone writes several values.
    if (!m_reported) {
        m_reported = true;
        QString why = m_store.failureReason();
        if (why.isEmpty())
            why = QStringLiteral("Check that the folder can be written to and that the disk is "
                                 "not full.");
        m_dialogs.MsgBox(nullptr,
                         QStringLiteral("lum could not save its settings to\r\n") + m_location +
                             QStringLiteral("\r\n\r\n") + why +
                             QStringLiteral(" Your changes are kept until lum ends and saved "
                                            "with the next change that can be written."),
                         MsgButtons::Ok, MsgIcon::Exclamation, QStringLiteral("lum"));
    }
    return false;
}
