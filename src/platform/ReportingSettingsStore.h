#pragma once

#include "platform/SettingsStore.h"

class Dialogs;

// Hands every call to another store and tells the user when a change could not be
// written (a read-only settings folder, a full disk). The value stays in memory, and the
// next change that can be written stores everything, so the user is told once, and again
// only after a write has worked in between.
class ReportingSettingsStore final : public SettingsStore {
public:
    ReportingSettingsStore(SettingsStore& store, Dialogs& dialogs, QString location);

    QString GetSetting(const QString& section, const QString& key,
                       const QString& def = QString()) const override;
    bool SaveSetting(const QString& section, const QString& key, const QString& value) override;
    bool DeleteSetting(const QString& section, const QString& key) override;
    QString failureReason() const override { return m_store.failureReason(); }

private:
    bool reportFailure(bool written);

    SettingsStore& m_store;
    Dialogs& m_dialogs;
    QString m_location;
    bool m_reported = false;
};
