#pragma once

#include "platform/Registry.h"

#include <QString>
#include <QtGlobal>

#include <optional>

struct Platform;
class QWidget;

// Where the system information tool is registered: its full path, or failing that the
// folder that holds MSINFO32.EXE.
inline constexpr char kSysInfoPathKey[] = "SOFTWARE\\Microsoft\\Shared Tools\\MSINFO";
inline constexpr char kSysInfoPathValue[] = "PATH";
inline constexpr char kSysInfoFolderKey[] = "SOFTWARE\\Microsoft\\Shared Tools Location";
inline constexpr char kSysInfoFolderValue[] = "MSINFO";

// A registry value as text: a string up to its first NUL; a number as "&h" and its
// hexadecimal digits, highest byte first; nothing for any other type.
std::optional<QString> registryValueText(const RegistryValue& value);

// Reads one value as text into KeyVal. False, with KeyVal emptied, when the key or the
// value is missing; a value of a type that has no text form leaves KeyVal as it was.
bool GetKeyValue(Registry& registry, quint32 KeyRoot, const QString& KeyName,
                 const QString& SubKeyRef, QString& KeyVal);

// Starts the system information tool, or says that there is none.
void StartSysInfo(Platform& platform, QWidget* owner);
