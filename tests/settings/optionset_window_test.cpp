#include "support/Boxes.h"
#include "support/DiskFull.h"

#include "emulator/ConfigRecord.h"
#include "settings/frmSettings.h"
#include "ui/vbalProgressBar.h"

#include <QCheckBox>
#include <QComboBox>
#include <QDir>
#include <QFile>
#include <QLabel>
#include <QLineEdit>
#include <QLocale>
#include <QRadioButton>
#include <QtEndian>

#include <gtest/gtest.h>

#include <cstring>
#include <memory>

namespace {

QByteArray readAll(const QString& path) {
    QFile f(path);
    return f.open(QIODevice::ReadOnly) ? f.readAll() : QByteArray("<unreadable>");
}

void writeBytes(const QString& path, const QByteArray& bytes) {
    QFile f(path);
    ASSERT_TRUE(f.open(QIODevice::WriteOnly));
    ASSERT_EQ(f.write(bytes), bytes.size());
}

void putInt16(QByteArray& bytes, int offset, qint16 value) {
    qToLittleEndian<qint16>(value, bytes.data() + offset);
}

void putSingle(QByteArray& bytes, int offset, float value) {
    quint32 bits = 0;
    std::memcpy(&bits, &value, sizeof bits);
    qToLittleEndian<quint32>(bits, bytes.data() + offset);
}

// What a control shows, as one comparable text, found by its control name.
QString controlState(const frmSettings& w, const ConfigFieldInfo& info) {
    QString name = QLatin1String(info.control);
    // The paddle arrays' buttons are named by element: optPaddleM1_0 ... optPaddleM1_3.
    if (name == "optPaddleKey" || name == "optPaddleM1" || name == "optPaddleM2")
        name += u'_' + QString::number(info.element);
    const QWidget* control = w.findChild<QWidget*>(name);
    if (const auto* list = qobject_cast<const QComboBox*>(control))
        return QString::number(list->currentIndex());
    if (const auto* button = qobject_cast<const QRadioButton*>(control))
        return button->isChecked() ? "on" : "off";
    if (const auto* box = qobject_cast<const QCheckBox*>(control))
        return QString::number(int(box->checkState()));
    if (const auto* field = qobject_cast<const QLineEdit*>(control))
        return field->text();
    if (const auto* bar = qobject_cast<const vbalProgressBar*>(control))
        return QString::number(bar->Value());
    return "<no control " + name + ">";
}

class OptionSet : public ::testing::Test {
protected:
    void SetUp() override { QLocale::setDefault(QLocale(QLocale::English, QLocale::UnitedStates)); }
    void TearDown() override { QLocale::setDefault(m_savedLocale); }

    std::unique_ptr<frmSettings> open() { return std::make_unique<frmSettings>(fake.platform); }

    // Saves through the Save button, the chooser answering `chosen`.
    void save(frmSettings& w, const QString& chosen) {
        fake.dialogs.paths.push_back(chosen);
        w.cmdSaveDat_Click();
    }
    QByteArray savedBytes(frmSettings& w) {
        save(w, fake.root() + "/snapshot.lum");
        return readAll(fake.root() + "/snapshot.lum");
    }
    bool loadBytes(frmSettings& w, const QByteArray& bytes) {
        writeBytes(fake.root() + "/load.lum", bytes);
        return w.LoadSettings(fake.root() + "/load.lum");
    }
    // The option set of a window as it starts.
    QByteArray initialBytes() { return savedBytes(*open()); }

    // A state in which every option control differs from its start.
    static void setKnownState(frmSettings& w) {
        w.comboVideoMode->setCurrentIndex(4);
        w.comboLeftController->setCurrentIndex(2);
        w.comboRightController->setCurrentIndex(5);
        w.comboGT->setCurrentIndex(13);
        for (QRadioButton* button :
             {w.optVMWindow, w.optDSPHigh, w.optSCBMP, w.optPaddleKey[1], w.optPaddleM1[2],
              w.optPaddleM2[3], w.optFPScustom, w.optNarrow2, w.optCPSECAM})
            button->setChecked(true);
        for (QCheckBox* box :
             {w.chkP0Hard, w.chkBW, w.chkIPCKeyboard, w.chkIPCJoystick, w.chkIPCStella,
              w.chkLightGun, w.chkSwapControl, w.chkQuiet, w.chkLowerSens, w.chkPALColorLoss,
              w.chkInterlaced, w.chkSyncWSound, w.chkScanLines, w.chkShowScanline, w.chkCodeTrace,
              w.chkPrintChecksum, w.chkFastCopy, w.chkAllow4, w.chkLineScan})
            box->setCheckState(Qt::Checked);
        w.chkP1Hard->setCheckState(Qt::PartiallyChecked);
        w.chkIPCMouse->setCheckState(Qt::PartiallyChecked);
        w.chkMouseCapture->setCheckState(Qt::Unchecked);
        w.BarColorPaddle->setValue(11);
        w.BarColorSoundQueue->setMin(4900);
        w.BarColorSoundQueue->setMax(5100);
        w.BarColorSoundQueue->setValue(5000);
        w.BarColorPhos->setValue(40);
        // Last: a text change refreshes the preview with everything above.
        for (const auto& [field, text] : {std::pair{w.txtLightGunCycles, "3"},
                                          {w.txtLightGunScan, "7"},
                                          {w.txtLowerSens, "4"},
                                          {w.txtFPScustom, "59.94"},
                                          {w.txtScanLines, "250"},
                                          {w.txtLineScan, "30"}})
            field->setText(text);
    }

    FakePlatform fake;
    QLocale m_savedLocale;
};

} // namespace

TEST_F(OptionSet, SaveWritesEveryFieldAtItsOffsetAndZerosElsewhere) {
    auto w = open();
    setKnownState(*w);
    const std::pair<int, qint16> ints[] = {
        {0, 4},   {2, 0},    {4, 0},   {6, -1},  {8, 0},   {10, 0},   {12, -1},  {14, 1},
        {16, 2},  {18, 1},   {20, 0},  {22, -1}, {42, 1},  {52, 1},   {68, 0},   {70, -1},
        {72, 0},  {74, 0},   {76, 0},  {78, 0},  {80, -1}, {82, 0},   {84, 0},   {86, 0},
        {88, 0},  {90, -1},  {92, 1},  {94, 1},  {96, 0},  {98, 0},   {100, -1}, {106, 0},
        {108, 0}, {110, -1}, {112, 0}, {114, 0}, {116, 0}, {118, -1}, {124, 1},  {130, 0},
        {132, 1}, {134, 1},  {136, 1}, {138, 1}, {140, 1}, {142, 13}, {144, 1},  {150, 1},
        {152, 2}, {154, 5},  {156, 1}, {158, 2}, {160, 1}, {162, 1},  {164, 1},  {166, 1},
    };
    const std::pair<int, float> singles[] = {
        {44, 3.0f},   {48, 7.0f},    {54, 5000.0f}, {60, 11.0f}, {102, 59.94f},
        {120, 40.0f}, {126, 250.0f}, {146, 30.0f},  {168, 4.0f},
    };
    QByteArray expected(172, '\0');
    for (const auto& [offset, value] : ints)
        putInt16(expected, offset, value);
    for (const auto& [offset, value] : singles)
        putSingle(expected, offset, value);
    EXPECT_EQ(savedBytes(*w).toHex(' '), expected.toHex(' '));
}

TEST_F(OptionSet, EveryControlRoundTripsAndTheWindowShowsIt) {
    auto source = open();
    setKnownState(*source);
    const QByteArray bytes = savedBytes(*source);
    auto target = open();
    ASSERT_TRUE(loadBytes(*target, bytes));
    for (const ConfigFieldInfo& info : configFields())
        EXPECT_EQ(controlState(*target, info), controlState(*source, info))
            << info.control << ' ' << info.element;
    EXPECT_EQ(savedBytes(*target).toHex(' '), bytes.toHex(' '));
    // A load that succeeds leaves the window as it was, hidden here.
    EXPECT_FALSE(target->isVisible());
    EXPECT_TRUE(fake.dialogs.boxes.empty());
    // The bars' texts, the re-centred sound-queue scale, the preview, and the number fields
    // that their boxes switch on.
    EXPECT_EQ(QStringList({QString::number(target->BarColorSoundQueue->Min()),
                           QString::number(target->BarColorSoundQueue->Max()),
                           target->BarColorSoundQueue->Text(), target->BarColorPaddle->Text(),
                           target->BarColorPhos->Text()}),
              QStringList({"4900", "5100", "5,000", "11", "40"}));
    EXPECT_EQ(target->lblDOSOutput->text(), source->lblDOSOutput->text());
    EXPECT_TRUE(target->txtScanLines->isEnabled() && target->txtLineScan->isEnabled() &&
                target->txtFPScustom->isEnabled());

    // The start state loaded back undoes every change; a grayed box given 1 goes back to
    // the two states a click moves between.
    const QByteArray start = initialBytes();
    ASSERT_TRUE(loadBytes(*target, start));
    EXPECT_EQ(savedBytes(*target).toHex(' '), start.toHex(' '));
    EXPECT_FALSE(target->txtScanLines->isEnabled());
    EXPECT_FALSE(target->chkP1Hard->isTristate());
}

// The lowest sound-queue window lets the slider reach a single digit; the set saved with
// it loads again, with the slider where it was.
TEST_F(OptionSet, ASoundQueueOfOneDigitSavesAndLoads) {
    auto source = open();
    for (int i = 0; i < 60; ++i)
        source->BarColorSoundQueue_KeyPress('-');
    ASSERT_EQ(source->BarColorSoundQueue->Min(), 1);
    source->BarColorSoundQueue->setValue(5);
    auto target = open();
    ASSERT_TRUE(loadBytes(*target, savedBytes(*source)));
    EXPECT_EQ(target->BarColorSoundQueue->Value(), 5);
    EXPECT_TRUE(fake.dialogs.boxes.empty());
}

TEST_F(OptionSet, ButtonsAskReportAndAddTheExtension) {
    auto w = open();
    w->lblConfig->setText("before");
    w->lblConfig->setToolTip("tip");
    w->cmdSaveDat_Click(); // cancelled
    w->cmdLoadDat_Click(); // cancelled
    EXPECT_EQ(w->lblConfig->text(), "before");
    EXPECT_EQ(w->lblConfig->toolTip(), "tip");
    ASSERT_EQ(fake.dialogs.fileRequests.size(), 2u);
    for (const auto& [isSave, request] : fake.dialogs.fileRequests) {
        EXPECT_EQ(QStringList({request.title, request.filter, request.initialFolder}),
                  QStringList({"Choose File to Save Configuration",
                               "lum configurations (*.lum)|*.lum|All Files (*.*)|*.*",
                               fake.programFolder()}));
        EXPECT_EQ(request.filterIndex, 1);
        EXPECT_EQ(request.flags, isSave ? 0x2u : 0x1800u);
    }
    EXPECT_TRUE(fake.dialogs.fileRequests[0].save);

    // The name as chosen in the label; ".lum" added unless the name ends in it.
    for (const auto& [chosen, written] :
         {std::pair{"name", "name.lum"}, {"NAME.LUM", "NAME.LUM"}}) {
        save(*w, fake.root() + "/" + chosen);
        EXPECT_EQ(readAll(fake.root() + "/" + written).size(), 172) << chosen;
        EXPECT_EQ(w->lblConfig->text(), QString(chosen) + " was succesfully saved");
    }
    EXPECT_EQ(w->lblConfig->toolTip(), "");
    EXPECT_FALSE(QFile::exists(fake.root() + "/name"));

    QByteArray bad = readAll(fake.root() + "/name.lum");
    putInt16(bad, 16, 7);
    writeBytes(fake.root() + "/bad.lum", bad);
    fake.dialogs.paths = {fake.root() + "/name.lum", fake.root() + "/bad.lum"};
    w->cmdLoadDat_Click();
    EXPECT_EQ(w->lblConfig->text(), "name.lum was succesfully loaded");
    EXPECT_TRUE(fake.dialogs.boxes.empty());
    w->cmdLoadDat_Click();
    EXPECT_EQ(w->lblConfig->text(),
              "bad.lum is corrupt.  Plese verify settings an re-save to correct the problem");
    EXPECT_EQ(fake.dialogs.boxes.size(), 1u);
}

TEST_F(OptionSet, NumberFieldsKeepTheirLeadingNumber) {
    auto w = open();
    w->txtLowerSens->setText("12abc");
    w->txtFPScustom->setText("abc");
    auto target = open();
    ASSERT_TRUE(loadBytes(*target, savedBytes(*w)));
    EXPECT_EQ(target->txtLowerSens->text(), "12");
    EXPECT_EQ(target->txtFPScustom->text(), "0");
}

TEST_F(OptionSet, ABadFieldStopsTheLoadWithWhatCameBeforeApplied) {
    QByteArray bytes = initialBytes();
    for (const auto& [offset, value] : {std::pair<int, qint16>{0, 3}, // video mode
                                        {2, 0},                       // optVMDefault
                                        {4, -1},                      // optVMFull
                                        {12, -1},                     // optDSPHigh
                                        {8, 0},                       // optDSPDefault
                                        {14, 3},                      // chkP0Hard: no such state
                                        {16, 1},                      // chkP1Hard, after it
                                        {22, -1},                     // optSCBMP
                                        {20, 0}})
        putInt16(bytes, offset, value);
    auto w = open();
    w->SelectTab("Video");
    EXPECT_FALSE(loadBytes(*w, bytes));
    EXPECT_EQ(w->comboVideoMode->currentIndex(), 3);
    EXPECT_TRUE(w->optVMFull->isChecked() && w->optDSPHigh->isChecked() &&
                w->optSCPCX->isChecked());
    EXPECT_EQ(w->chkP0Hard->checkState(), Qt::Unchecked);
    EXPECT_EQ(w->chkP1Hard->checkState(), Qt::Unchecked);
    EXPECT_TRUE(w->lblDOSOutput->text().contains("-v3")); // the preview shows what was applied
    EXPECT_EQ(boxLines(fake.dialogs), Lines{"lum | .lum file is corrupt\r\nPlease verify settings "
                                            "and re-save to correct this problem | Ok | None"});
    EXPECT_TRUE(w->isVisible());
    EXPECT_EQ(w->SelectedTabKey(), "Settings");

    // The lists' lengths bound their fields; a file too short or unreadable applies nothing.
    QByteArray fiveModes = initialBytes();
    putInt16(fiveModes, 0, 5);
    for (const auto& [offset, value] : {std::pair<int, qint16>{0, 9}, {152, 13}, {142, 14}}) {
        QByteArray wrong = fiveModes;
        putInt16(wrong, offset, value);
        EXPECT_FALSE(loadBytes(*open(), wrong)) << offset << ' ' << value;
    }
    fake.dialogs.boxes.clear();
    auto other = open();
    EXPECT_FALSE(other->LoadSettings(fake.root() + "/missing.lum"));
    EXPECT_FALSE(other->LoadSettings(fake.makeFolder("a folder.lum")));
    EXPECT_FALSE(loadBytes(*other, fiveModes.left(171)));
    EXPECT_EQ(other->comboVideoMode->currentIndex(), 0);
    EXPECT_EQ(fake.dialogs.boxes.size(), 3u);
    // Bytes past the record are ignored.
    EXPECT_TRUE(loadBytes(*other, fiveModes + QByteArray(10, '\x7F')));
    EXPECT_EQ(other->comboVideoMode->currentIndex(), 5);
}

TEST_F(OptionSet, OptionGroupsTakeTheirLastFlagOrTheirDefault) {
    QByteArray bytes = initialBytes();
    // Paddles: none of mouse 1's flags, two of mouse 2's (the later wins).
    for (int offset = 68; offset < 92; offset += 2)
        putInt16(bytes, offset, 0);
    putInt16(bytes, 86, -1);
    putInt16(bytes, 90, -1);
    // Video mode: no flag at all; colour palette: two; screen capture: 0x1234 selects.
    for (int offset : {2, 4, 6, 20})
        putInt16(bytes, offset, 0);
    putInt16(bytes, 112, -1);
    putInt16(bytes, 116, -1);
    putInt16(bytes, 22, 0x1234);
    putInt16(bytes, 142, -1); // a list given -1 shows no entry

    auto w = open();
    w->optPaddleKey[3]->setChecked(true);
    w->optPaddleM1[2]->setChecked(true);
    w->optPaddleM2[0]->setChecked(true);
    w->optVMFull->setChecked(true);
    ASSERT_TRUE(loadBytes(*w, bytes));
    QStringList selected;
    for (const QRadioButton* button : w->findChildren<QRadioButton*>())
        if (button->isChecked())
            selected << button->objectName();
    selected.sort();
    EXPECT_EQ(selected, QStringList({"optCPPAL", "optDSPDefault", "optFPSDefault", "optJoyDefault",
                                     "optNarrowNot", "optPaddleKeyNone", "optPaddleM1None",
                                     "optPaddleM2_3", "optSCBMP", "optVMDefault"}));
    EXPECT_EQ(w->comboGT->currentIndex(), -1);
}

TEST_F(OptionSet, SavingNeverLosesAFile) {
    auto w = open();
    save(*w, fake.root() + "/no such folder/set");
    EXPECT_EQ(w->lblConfig->text(), "error saving set");

    const QString older = fake.root() + "/older.lum";
    writeBytes(older, QByteArray(172, '\x11'));
    {
        const DiskFull limit(16);
        save(*w, older);
    }
    EXPECT_EQ(w->lblConfig->text(), "error saving older.lum");
    EXPECT_EQ(readAll(older), QByteArray(172, '\x11'));

    // A name the extension was added to does not replace a file unasked.
    w->lblConfig->setText("before");
    fake.dialogs.answers = {MsgResult::No, MsgResult::Yes};
    save(*w, fake.root() + "/older");
    EXPECT_EQ(readAll(older), QByteArray(172, '\x11'));
    EXPECT_EQ(w->lblConfig->text(), "before");
    save(*w, fake.root() + "/older");
    EXPECT_EQ(readAll(older), initialBytes());
    EXPECT_EQ(w->lblConfig->text(), "older was succesfully saved");
    EXPECT_EQ(boxLines(fake.dialogs),
              Lines(2, "Choose File to Save Configuration | older.lum already exists.\r\nDo you "
                       "want to replace it? | YesNo | Exclamation"));
    // A name chosen with its extension was asked about by the chooser itself.
    save(*w, older);
    EXPECT_EQ(fake.dialogs.boxes.size(), 2u);
}
