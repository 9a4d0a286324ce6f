#include "support/DiskFull.h"
#include "support/FakePlatform.h"

#include "QtPrinters.h"

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

#include <csignal>
#include <cstring>
#include <memory>
#include <sys/resource.h>

namespace {

// Bytes as hex text, so that a difference reads well.
QString hex(const QByteArray& bytes) {
    return QString::fromLatin1(bytes.toHex(' '));
}

QByteArray readAll(const QString& path) {
    QFile f(path);
    return f.open(QIODevice::ReadOnly) ? f.readAll() : QByteArray("<unreadable>");
}

void writeBytes(const QString& path, const QByteArray& bytes) {
    QFile f(path);
    ASSERT_TRUE(f.open(QIODevice::WriteOnly));
    ASSERT_EQ(f.write(bytes), bytes.size());
}

qint16 int16At(const QByteArray& bytes, int offset) {
    return qFromLittleEndian<qint16>(bytes.constData() + offset);
}

float singleAt(const QByteArray& bytes, int offset) {
    const quint32 bits = qFromLittleEndian<quint32>(bytes.constData() + offset);
    float value = 0;
    std::memcpy(&value, &bits, sizeof value);
    return value;
}

void putInt16(QByteArray& bytes, int offset, qint16 value) {
    qToLittleEndian<qint16>(value, bytes.data() + offset);
}

// What a control shows, as one comparable text, found by its control name.
QString controlState(const frmSettings& w, const ConfigFieldInfo& info) {
    QString name = QLatin1String(info.control);
    // The paddle arrays' buttons are named by element: optPaddleM1_0 ... optPaddleM1_3.
    if (name == "optPaddleKey" || name == "optPaddleM1" || name == "optPaddleM2")
        name += u'_' + QString::number(info.element);
    const QWidget* control = w.findChild<QWidget*>(name);
    if (control == nullptr)
        return "<no control " + name + ">";
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
    return "<unknown kind " + name + ">";
}

class OptionSet : public ::testing::Test {
protected:
    void SetUp() override {
        m_savedLocale = QLocale();
        QLocale::setDefault(QLocale(QLocale::English, QLocale::UnitedStates));
    }
    void TearDown() override { QLocale::setDefault(m_savedLocale); }

    std::unique_ptr<frmSettings> open() { return std::make_unique<frmSettings>(fake.platform); }

    // Saves through the Save button, the chooser answering `chosen`.
    void save(frmSettings& w, const QString& chosen) {
        fake.dialogs.paths.push_back(chosen);
        w.cmdSaveDat_Click();
    }
    QByteArray savedBytes(frmSettings& w) {
        const QString path = fake.root() + "/snapshot.lum";
        save(w, path);
        return readAll(path);
    }
    bool loadBytes(frmSettings& w, const QByteArray& bytes) {
        const QString path = fake.root() + "/load.lum";
        writeBytes(path, bytes);
        return w.LoadSettings(path);
    }
    // The option set of a window as it starts.
    QByteArray initialBytes() { return savedBytes(*open()); }

    // A state in which every option control differs from its start.
    static void setKnownState(frmSettings& w) {
        w.comboVideoMode->setCurrentIndex(4);
        w.optVMWindow->setChecked(true);
        w.optDSPHigh->setChecked(true);
        w.chkP0Hard->setCheckState(Qt::Checked);
        w.chkP1Hard->setCheckState(Qt::PartiallyChecked);
        w.chkBW->setCheckState(Qt::Checked);
        w.optSCBMP->setChecked(true);
        w.comboLeftController->setCurrentIndex(2);
        w.comboRightController->setCurrentIndex(5);
        w.chkIPCKeyboard->setCheckState(Qt::Checked);
        w.chkIPCMouse->setCheckState(Qt::PartiallyChecked);
        w.chkIPCJoystick->setCheckState(Qt::Checked);
        w.chkIPCStella->setCheckState(Qt::Checked);
        w.BarColorPaddle->setValue(11);
        w.chkLightGun->setCheckState(Qt::Checked);
        w.txtLightGunCycles->setText("3");
        w.txtLightGunScan->setText("7");
        w.chkSwapControl->setCheckState(Qt::Checked);
        w.chkQuiet->setCheckState(Qt::Checked);
        w.BarColorSoundQueue->setMin(4900);
        w.BarColorSoundQueue->setMax(5100);
        w.BarColorSoundQueue->setValue(5000);
        w.chkLowerSens->setCheckState(Qt::Checked);
        w.txtLowerSens->setText("4");
        w.optPaddleKey[1]->setChecked(true);
        w.optPaddleM1[2]->setChecked(true);
        w.optPaddleM2[3]->setChecked(true);
        w.chkPALColorLoss->setCheckState(Qt::Checked);
        w.chkInterlaced->setCheckState(Qt::Checked);
        w.chkSyncWSound->setCheckState(Qt::Checked);
        w.optFPScustom->setChecked(true);
        w.txtFPScustom->setText("59.94");
        w.optNarrow2->setChecked(true);
        w.optCPSECAM->setChecked(true);
        w.BarColorPhos->setValue(40);
        w.chkScanLines->setCheckState(Qt::Checked);
        w.txtScanLines->setText("250");
        w.chkMouseCapture->setCheckState(Qt::Unchecked);
        w.chkShowScanline->setCheckState(Qt::Checked);
        w.chkCodeTrace->setCheckState(Qt::Checked);
        w.chkPrintChecksum->setCheckState(Qt::Checked);
        w.chkFastCopy->setCheckState(Qt::Checked);
        w.chkAllow4->setCheckState(Qt::Checked);
        w.comboGT->setCurrentIndex(13);
        w.chkLineScan->setCheckState(Qt::Checked);
        w.txtLineScan->setText("30");
    }

    FakePlatform fake;
    QLocale m_savedLocale;
};

} // namespace

TEST_F(OptionSet, SaveWritesEveryFieldAtItsOffset) {
    auto w = open();
    setKnownState(*w);
    const QByteArray bytes = savedBytes(*w);
    ASSERT_EQ(bytes.size(), 172);

    struct Int16Field {
        int offset;
        qint16 value;
    };
    const Int16Field ints[] = {
        {0, 4},   {2, 0},    {4, 0},   {6, -1},  {8, 0},   {10, 0},   {12, -1},  {14, 1},
        {16, 2},  {18, 1},   {20, 0},  {22, -1}, {42, 1},  {52, 1},   {68, 0},   {70, -1},
        {72, 0},  {74, 0},   {76, 0},  {78, 0},  {80, -1}, {82, 0},   {84, 0},   {86, 0},
        {88, 0},  {90, -1},  {92, 1},  {94, 1},  {96, 0},  {98, 0},   {100, -1}, {106, 0},
        {108, 0}, {110, -1}, {112, 0}, {114, 0}, {116, 0}, {118, -1}, {124, 1},  {130, 0},
        {132, 1}, {134, 1},  {136, 1}, {138, 1}, {140, 1}, {142, 13}, {144, 1},  {150, 1},
        {152, 2}, {154, 5},  {156, 1}, {158, 2}, {160, 1}, {162, 1},  {164, 1},  {166, 1},
    };
    for (const Int16Field& f : ints)
        EXPECT_EQ(int16At(bytes, f.offset), f.value) << "offset " << f.offset;

    const std::pair<int, float> singles[] = {
        {44, 3.0f},   {48, 7.0f},    {54, 5000.0f}, {60, 11.0f}, {102, 59.94f},
        {120, 40.0f}, {126, 250.0f}, {146, 30.0f},  {168, 4.0f},
    };
    for (const auto& [offset, value] : singles)
        EXPECT_EQ(singleAt(bytes, offset), value) << "offset " << offset;

    // Every byte is one of the fields above or reserved.
    QByteArray expected(172, '\0');
    for (const Int16Field& f : ints)
        putInt16(expected, f.offset, f.value);
    for (const auto& [offset, value] : singles) {
        quint32 bits = 0;
        std::memcpy(&bits, &value, sizeof bits);
        qToLittleEndian<quint32>(bits, expected.data() + offset);
    }
    EXPECT_EQ(hex(bytes), hex(expected));
}

TEST_F(OptionSet, SaveClearsTheReservedBytesOfAnOlderFile) {
    const QString path = fake.root() + "/old.lum";
    writeBytes(path, QByteArray(300, '\xA5'));
    auto w = open();
    save(*w, path);
    const QByteArray bytes = readAll(path);
    ASSERT_EQ(bytes.size(), 172);
    EXPECT_EQ(bytes.mid(24, 18), QByteArray(18, '\0'));
    EXPECT_EQ(bytes.mid(58, 2), QByteArray(2, '\0'));
    EXPECT_EQ(bytes.mid(64, 4), QByteArray(4, '\0'));
    EXPECT_EQ(w->lblConfig->text(), "old.lum was succesfully saved");
}

TEST_F(OptionSet, EveryControlRoundTrips) {
    auto source = open();
    setKnownState(*source);
    const QByteArray bytes = savedBytes(*source);

    auto target = open();
    ASSERT_TRUE(loadBytes(*target, bytes));
    for (const ConfigFieldInfo& info : configFields())
        EXPECT_EQ(controlState(*target, info), controlState(*source, info))
            << info.control << ' ' << info.element;
    EXPECT_EQ(hex(savedBytes(*target)), hex(bytes));
    // A load that succeeds leaves the window as it was, hidden here.
    EXPECT_FALSE(target->isVisible());
    EXPECT_TRUE(fake.dialogs.boxes.empty());

    // The loaded window also shows it: the bars' texts, the re-centred sound-queue scale,
    // the preview of the switches.
    EXPECT_EQ(target->BarColorSoundQueue->Min(), 4900);
    EXPECT_EQ(target->BarColorSoundQueue->Max(), 5100);
    EXPECT_EQ(target->BarColorSoundQueue->Text(), "5,000");
    EXPECT_EQ(target->BarColorPaddle->Text(), "11");
    EXPECT_EQ(target->BarColorPhos->Text(), "40");
    EXPECT_EQ(target->lblDOSOutput->text(), source->lblDOSOutput->text());
    // The reactions ran: the number fields their boxes switch on are enabled.
    EXPECT_TRUE(target->txtScanLines->isEnabled());
    EXPECT_TRUE(target->txtLineScan->isEnabled());
    EXPECT_TRUE(target->txtFPScustom->isEnabled());
}

TEST_F(OptionSet, LoadingTheStartStateUndoesEveryChange) {
    const QByteArray start = initialBytes();
    auto w = open();
    setKnownState(*w);
    ASSERT_TRUE(loadBytes(*w, start));
    EXPECT_EQ(hex(savedBytes(*w)), hex(start));
    EXPECT_FALSE(w->txtScanLines->isEnabled());
    // A grayed box given 0 or 1 goes back to the two states a click moves between.
    EXPECT_FALSE(w->chkP1Hard->isTristate());
}

TEST_F(OptionSet, SavePathGetsTheExtensionUnlessItEndsInLum) {
    const struct {
        const char* chosen;
        const char* written;
    } cases[] = {
        {"name", "name.lum"},
        {"NAME.LUM", "NAME.LUM"},
        {"x.lum.bak", "x.lum.bak.lum"},
        {"a.txt", "a.txt.lum"},
    };
    auto w = open();
    for (const auto& c : cases) {
        const QString chosen = fake.root() + "/" + c.chosen;
        save(*w, chosen);
        EXPECT_EQ(readAll(fake.root() + "/" + c.written).size(), 172) << c.chosen;
        EXPECT_EQ(w->lblConfig->text(), QString(c.chosen) + " was succesfully saved");
    }
    EXPECT_FALSE(QFile::exists(fake.root() + "/name"));
    EXPECT_FALSE(QFile::exists(fake.root() + "/x.lum.bak"));
}

TEST_F(OptionSet, SaveAndLoadDialogsAskAsTheyShould) {
    auto w = open();
    w->lblConfig->setText("before");
    w->lblConfig->setToolTip("tip");
    w->cmdSaveDat_Click(); // cancelled
    w->cmdLoadDat_Click(); // cancelled
    EXPECT_EQ(w->lblConfig->text(), "before");
    EXPECT_EQ(w->lblConfig->toolTip(), "tip");
    EXPECT_TRUE(QDir(fake.programFolder()).entryList({"*.lum"}).isEmpty());

    ASSERT_EQ(fake.dialogs.fileRequests.size(), 2u);
    const FileDialogRequest& saveAsk = fake.dialogs.fileRequests[0].request;
    const FileDialogRequest& loadAsk = fake.dialogs.fileRequests[1].request;
    EXPECT_TRUE(fake.dialogs.fileRequests[0].save);
    EXPECT_FALSE(fake.dialogs.fileRequests[1].save);
    for (const FileDialogRequest* ask : {&saveAsk, &loadAsk}) {
        EXPECT_EQ(ask->title, "Choose File to Save Configuration");
        EXPECT_EQ(ask->filter, "lum configurations (*.lum)|*.lum|All Files (*.*)|*.*");
        EXPECT_EQ(ask->filterIndex, 1);
        EXPECT_EQ(ask->initialFolder, fake.programFolder());
    }
    EXPECT_EQ(saveAsk.flags, 0x2u);
    EXPECT_EQ(loadAsk.flags, 0x1800u);
}

TEST_F(OptionSet, LoadButtonReportsInTheStatusLabel) {
    auto w = open();
    const QString good = fake.root() + "/good.lum";
    save(*w, good);
    QByteArray bad = readAll(good);
    putInt16(bad, 16, 7);
    const QString badPath = fake.root() + "/bad.lum";
    writeBytes(badPath, bad);

    w->lblConfig->setToolTip("tip");
    fake.dialogs.paths.push_back(good);
    w->cmdLoadDat_Click();
    EXPECT_EQ(w->lblConfig->text(), "good.lum was succesfully loaded");
    EXPECT_EQ(w->lblConfig->toolTip(), "");
    EXPECT_TRUE(fake.dialogs.boxes.empty());

    fake.dialogs.paths.push_back(badPath);
    w->cmdLoadDat_Click();
    EXPECT_EQ(w->lblConfig->text(),
              "bad.lum is corrupt.  Plese verify settings an re-save to correct the problem");
    EXPECT_EQ(fake.dialogs.boxes.size(), 1u);
}

TEST_F(OptionSet, NumberFieldsKeepTheirLeadingNumber) {
    auto w = open();
    w->txtLowerSens->setText("12abc");
    w->txtFPScustom->setText("abc");
    const QByteArray bytes = savedBytes(*w);
    EXPECT_EQ(singleAt(bytes, 168), 12.0f);
    EXPECT_EQ(singleAt(bytes, 102), 0.0f);

    auto target = open();
    ASSERT_TRUE(loadBytes(*target, bytes));
    EXPECT_EQ(target->txtLowerSens->text(), "12");
    EXPECT_EQ(target->txtFPScustom->text(), "0");
}

TEST_F(OptionSet, SoundQueueScaleFollowsTheLoadedValue) {
    const QByteArray start = initialBytes();
    const struct {
        float stored;
        bool ok;
        int min, max;
        const char* text;
    } cases[] = {
        {4608, true, 4500, 4700, "4,608"},
        {50, true, -100, 100, "50"},
        {12345, true, 12200, 12400, "12,345"},
        {5, false, 4500, 4700, "4,608"},
    };
    for (const auto& c : cases) {
        QByteArray bytes = start;
        quint32 bits = 0;
        std::memcpy(&bits, &c.stored, sizeof bits);
        qToLittleEndian<quint32>(bits, bytes.data() + 54);
        putInt16(bytes, 52, 1); // chkQuiet, applied just before the sound queue

        auto w = open();
        EXPECT_EQ(loadBytes(*w, bytes), c.ok) << c.stored;
        EXPECT_EQ(w->BarColorSoundQueue->Min(), c.min) << c.stored;
        EXPECT_EQ(w->BarColorSoundQueue->Max(), c.max) << c.stored;
        EXPECT_EQ(w->BarColorSoundQueue->Text(), c.text) << c.stored;
        EXPECT_EQ(w->BarColorSoundQueue->Value(), c.ok ? int(c.stored) : 4608);
        EXPECT_EQ(w->chkQuiet->checkState(), Qt::Checked) << c.stored;
        EXPECT_EQ(fake.dialogs.boxes.size(), c.ok ? 0u : 1u) << c.stored;
        fake.dialogs.boxes.clear();
    }
}

TEST_F(OptionSet, BadCheckBoxStopsTheLoadWithWhatCameBeforeApplied) {
    QByteArray bytes = initialBytes();
    putInt16(bytes, 0, 3);   // video mode
    putInt16(bytes, 2, 0);   // optVMDefault
    putInt16(bytes, 4, -1);  // optVMFull
    putInt16(bytes, 12, -1); // optDSPHigh
    putInt16(bytes, 8, 0);   // optDSPDefault
    putInt16(bytes, 14, 3);  // chkP0Hard: no such state
    putInt16(bytes, 16, 1);  // chkP1Hard, after it
    putInt16(bytes, 22, -1); // optSCBMP
    putInt16(bytes, 20, 0);

    auto w = open();
    w->SelectTab("Video");
    EXPECT_FALSE(loadBytes(*w, bytes));

    EXPECT_EQ(w->comboVideoMode->currentIndex(), 3);
    EXPECT_TRUE(w->optVMFull->isChecked());
    EXPECT_TRUE(w->optDSPHigh->isChecked());
    EXPECT_EQ(w->chkP0Hard->checkState(), Qt::Unchecked);
    EXPECT_EQ(w->chkP1Hard->checkState(), Qt::Unchecked);
    EXPECT_TRUE(w->optSCPCX->isChecked());
    // The preview shows what was applied.
    EXPECT_TRUE(w->lblDOSOutput->text().contains("-v3"));

    ASSERT_EQ(fake.dialogs.boxes.size(), 1u);
    const FakeDialogs::Box& box = fake.dialogs.boxes[0];
    EXPECT_EQ(box.text, ".lum file is corrupt\r\nPlease verify settings and re-save to correct "
                        "this problem");
    EXPECT_EQ(box.title, "lum");
    EXPECT_EQ(box.buttons, MsgButtons::Ok);
    EXPECT_TRUE(w->isVisible());
    EXPECT_EQ(w->SelectedTabKey(), "Settings");
}

TEST_F(OptionSet, OtherRejectedValuesAreCorrupt) {
    const QByteArray start = initialBytes();
    const struct {
        int offset;
        qint16 value;
    } cases[] = {
        {0, 9},     // past the video-mode list
        {0, -2},    // below "nothing selected"
        {152, 13},  // past the controller list
        {142, 14},  // past the game-type list
        {166, -1},  // check box
        {144, 100}, // check box
    };
    for (const auto& c : cases) {
        QByteArray bytes = start;
        putInt16(bytes, c.offset, c.value);
        auto w = open();
        EXPECT_FALSE(loadBytes(*w, bytes)) << c.offset << ' ' << c.value;
    }
    // A value of 0xFFFF in an option button's field selects it like -1; a list given -1
    // shows no entry.
    QByteArray bytes = start;
    putInt16(bytes, 20, 0);
    putInt16(bytes, 22, 0x1234);
    putInt16(bytes, 142, -1);
    auto w = open();
    EXPECT_TRUE(loadBytes(*w, bytes));
    EXPECT_TRUE(w->optSCBMP->isChecked());
    EXPECT_EQ(w->comboGT->currentIndex(), -1);
}

TEST_F(OptionSet, OptionGroupsTakeTheirLastFlagOrTheirDefault) {
    QByteArray bytes = initialBytes();
    // Paddles: none of mouse 1's flags, two of mouse 2's (the later wins).
    for (int offset = 68; offset < 92; offset += 2)
        putInt16(bytes, offset, 0);
    putInt16(bytes, 86, -1);
    putInt16(bytes, 90, -1);
    // Video mode: no flag at all; colour palette: two.
    for (int offset : {2, 4, 6})
        putInt16(bytes, offset, 0);
    putInt16(bytes, 112, -1);
    putInt16(bytes, 116, -1);

    auto w = open();
    w->optPaddleKey[3]->setChecked(true);
    w->optPaddleM1[2]->setChecked(true);
    w->optPaddleM2[0]->setChecked(true);
    w->optVMFull->setChecked(true);
    ASSERT_TRUE(loadBytes(*w, bytes));

    for (int i = 0; i < 4; ++i) {
        EXPECT_FALSE(w->optPaddleKey[i]->isChecked()) << i;
        EXPECT_FALSE(w->optPaddleM1[i]->isChecked()) << i;
        EXPECT_EQ(w->optPaddleM2[i]->isChecked(), i == 3) << i;
    }
    EXPECT_TRUE(w->optPaddleKeyNone->isChecked());
    EXPECT_TRUE(w->optPaddleM1None->isChecked());
    EXPECT_FALSE(w->optPaddleM2None->isChecked());
    EXPECT_TRUE(w->optVMDefault->isChecked());
    EXPECT_FALSE(w->optVMFull->isChecked());
    EXPECT_TRUE(w->optCPPAL->isChecked());
    EXPECT_FALSE(w->optCPDefault->isChecked());
}

TEST_F(OptionSet, UnreadableOrShortFilesAreCorruptAndApplyNothing) {
    QByteArray full = initialBytes();
    putInt16(full, 0, 5);
    auto w = open();
    const QString folder = fake.makeFolder("a folder.lum");
    for (const QString& path : {fake.root() + "/missing.lum", folder}) {
        EXPECT_FALSE(w->LoadSettings(path)) << path.toStdString();
    }
    EXPECT_FALSE(loadBytes(*w, full.left(171)));
    EXPECT_FALSE(loadBytes(*w, QByteArray()));
    EXPECT_EQ(w->comboVideoMode->currentIndex(), 0);
    EXPECT_EQ(fake.dialogs.boxes.size(), 4u);

    // Bytes past the record are ignored.
    EXPECT_TRUE(loadBytes(*w, full + QByteArray(10, '\x7F')));
    EXPECT_EQ(w->comboVideoMode->currentIndex(), 5);
}

TEST_F(OptionSet, FailedSaveSaysSoAndKeepsAnOlderFile) {
    auto w = open();
    save(*w, fake.root() + "/no such folder/set");
    EXPECT_EQ(w->lblConfig->text(), "error saving set");

    const QString older = fake.root() + "/older.lum";
    const QByteArray olderBytes(172, '\x11');
    writeBytes(older, olderBytes);
    w->lblConfig->setToolTip("tip");
    {
        const DiskFull limit(16);
        save(*w, older);
    }
    EXPECT_EQ(w->lblConfig->text(), "error saving older.lum");
    EXPECT_EQ(w->lblConfig->toolTip(), "");
    EXPECT_EQ(readAll(older), olderBytes);
}

TEST_F(OptionSet, AddedExtensionDoesNotReplaceAFileUnasked) {
    const QString existing = fake.root() + "/mine.lum";
    const QByteArray olderBytes(172, '\x22');
    writeBytes(existing, olderBytes);
    auto w = open();
    w->lblConfig->setText("before");

    fake.dialogs.answers.push_back(MsgResult::No);
    save(*w, fake.root() + "/mine");
    EXPECT_EQ(readAll(existing), olderBytes);
    EXPECT_EQ(w->lblConfig->text(), "before");
    ASSERT_EQ(fake.dialogs.boxes.size(), 1u);
    EXPECT_EQ(fake.dialogs.boxes[0].text, "mine.lum already exists.\r\nDo you want to replace it?");
    EXPECT_EQ(fake.dialogs.boxes[0].buttons, MsgButtons::YesNo);

    fake.dialogs.answers.push_back(MsgResult::Yes);
    save(*w, fake.root() + "/mine");
    EXPECT_EQ(readAll(existing), initialBytes());
    EXPECT_EQ(w->lblConfig->text(), "mine was succesfully saved");

    // A name chosen with its extension was asked about by the chooser itself.
    save(*w, existing);
    EXPECT_EQ(fake.dialogs.boxes.size(), 2u);
}
