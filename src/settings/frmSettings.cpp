#include "settings/frmSettingsUi.h"

#include "platform/Dialogs.h"
#include "platform/Platform.h"
#include "platform/StoredSettings.h"
#include "settings/DefaultPaths.h"
#include "ui/OleColor.h"
#include "ui/PictureBox.h"
#include "ui/ScreenPlace.h"
#include "ui/Twips.h"
#include "ui/cTextBoxXP.h"

#include <QCheckBox>
#include <QCloseEvent>
#include <QComboBox>
#include <QCoreApplication>
#include <QDir>
#include <QDropEvent>
#include <QFileInfo>
#include <QGroupBox>
#include <QHeaderView>
#include <QLabel>
#include <QLineEdit>
#include <QMenu>
#include <QMimeData>
#include <QPushButton>
#include <QSignalBlocker>
#include <QStyle>
#include <QTabBar>
#include <QTabWidget>
#include <QTextDocument>
#include <QTreeWidget>
#include <QUrl>

namespace {

constexpr double kTabWidthTwips = 6495;
constexpr double kTabHeightTwips = 4095;
constexpr double kSideStripWidthTwips = 495;
constexpr double kCountColumnTwips = 1000;

const QString kDefaultPathsKey = QStringLiteral("DefaultPaths");

struct TabInfo {
    const char* key;
    const char* caption;
    QStyle::StandardPixmap icon;
};

constexpr TabInfo kTabs[] = {
    {"Settings", "Settings", QStyle::SP_FileDialogDetailedView},
    {"Controls", "Controls", QStyle::SP_ComputerIcon},
    {"PaddlesAudio", "Paddles / Audio", QStyle::SP_MediaVolume},
    {"Video", "Video", QStyle::SP_DesktopIcon},
    {"Debug", "Debugging", QStyle::SP_MessageBoxWarning},
    {"DefaultPaths", "Default Paths", QStyle::SP_DirIcon},
};

// The first dropped item as a local path, or the empty text when the drop carries no
// local file or folder (a web address, plain text).
QString firstDroppedPath(const QMimeData* data) {
    if (data == nullptr || !data->hasUrls())
        return QString();
    const QList<QUrl> urls = data->urls();
    if (urls.isEmpty() || !urls.first().isLocalFile())
        return QString();
    return QDir::cleanPath(urls.first().toLocalFile());
}

} // namespace

frmSettings::frmSettings(Platform& platform, QWidget* parent)
    : QWidget(parent, Qt::Window), m_platform(platform), m_ui(std::make_unique<Ui>()) {
    setObjectName(QStringLiteral("frmSettings"));
    setWindowTitle(QStringLiteral("Settings"));

    m_ui->picSideText = new PictureBox(this);
    m_ui->picSideText->setObjectName(QStringLiteral("picSideText"));
    // The caption runs up the dark end of the gradient.
    m_ui->picSideText->setForeColor(kOleWhite);
    QFont sideFont = m_ui->picSideText->font();
    sideFont.setBold(true);
    sideFont.setPointSize(10);
    m_ui->picSideText->setFont(sideFont);

    m_ui->vbalDTabControl1 = new QTabWidget(this);
    m_ui->vbalDTabControl1->setObjectName(QStringLiteral("vbalDTabControl1"));

    const char* pageNames[] = {"picSettings", "picControls", "picPaddlesAudio",
                               "picVideo",    "picDebug",    "picDefPaths"};
    for (size_t i = 0; i < m_ui->pages.size(); ++i) {
        m_ui->pages[i] = new QWidget;
        m_ui->pages[i]->setObjectName(QLatin1String(pageNames[i]));
    }
    createSettingsPage();
    createControlsPage();
    createPaddlesAudioPage();
    createVideoPage();
    createDebugPage();
    createDefaultPathsPage();
    createSoundQueueMenu();

    // Drops and keys of the Default Paths page; the balloon anchors follow the controls
    // whose tips they carry.
    for (QObject* watched :
         {static_cast<QObject*>(m_ui->txtDefPathz26), static_cast<QObject*>(m_ui->vbalListDefPaths),
          static_cast<QObject*>(m_ui->vbalListDefPaths->viewport()),
          static_cast<QObject*>(m_ui->comboVideoMode), static_cast<QObject*>(m_ui->ipc[3])})
        watched->installEventFilter(this);

    connect(m_ui->vbalDTabControl1, &QTabWidget::tabBarClicked, this,
            &frmSettings::vbalDTabControl1_TabClick);
    connect(m_ui->vbalDTabControl1, &QTabWidget::currentChanged, this,
            &frmSettings::vbalDTabControl1_TabSelected);
    connect(m_ui->txtDefPathFilter, &QLineEdit::textChanged, this,
            &frmSettings::txtDefPathFilter_Change);
    connect(m_ui->vbalListDefPaths, &QWidget::customContextMenuRequested, this,
            [this](const QPoint& pos) { vbalListDefPaths_MouseDown(Qt::RightButton, pos); });
    connect(m_ui->vbalListDefPaths, &QTreeWidget::itemChanged, this,
            &frmSettings::vbalListDefPaths_ItemChanged);

    Form_Load();
    connectOptionControls();
}

frmSettings::~frmSettings() = default;

const cLogo& frmSettings::Logo() const {
    return m_logo;
}

void frmSettings::Form_Load() {
    m_ui->txtDefPathFilter->setText(read(m_platform.store, stored::romFilter));

    // The path column takes what the count column leaves, so both stay in view.
    QTreeWidget* paths = m_ui->vbalListDefPaths;
    paths->setColumnCount(2);
    paths->setHeaderLabels({QStringLiteral("Path"), QStringLiteral("# ROM's")});
    paths->headerItem()->setToolTip(0, QStringLiteral("ROM's Path"));
    paths->headerItem()->setToolTip(1, QStringLiteral("The number of ROM's found"));
    QHeaderView* header = paths->header();
    header->setStretchLastSection(false);
    header->setSectionResizeMode(0, QHeaderView::Stretch);
    header->setSectionResizeMode(1, QHeaderView::Interactive);
    header->resizeSection(1, twips::toPixelsX(kCountColumnTwips));

    m_logo.setDrawingObject(m_ui->picSideText);
    m_logo.setCaption(QStringLiteral("Settings"));
    m_logo.setStartColor(0);
    m_logo.setEndColor(kOleButtonFace);

    QTabWidget* tabs = m_ui->vbalDTabControl1;
    for (size_t i = 0; i < std::size(kTabs); ++i) {
        const int index = tabs->addTab(m_ui->pages[i], style()->standardIcon(kTabs[i].icon),
                                       QLatin1String(kTabs[i].caption));
        tabs->tabBar()->setTabData(index, QLatin1String(kTabs[i].key));
    }
    placeTabControl();
    const WindowPlace place = read(m_platform.store, stored::settingsWindow);
    m_place = placeOnScreen(
        *this, QRect(twips::toPixelsX(place.left), twips::toPixelsY(place.top), width(), height()));

    LoadDefaultPaths();
}

void frmSettings::placeTabControl() {
    // The tab control's size in twips, grown where this platform's font needs more room
    // for the tabs or a page, so that every tab shows at once and nothing is cut off.
    const QSize content = m_ui->vbalDTabControl1->minimumSizeHint().expandedTo(
        QSize(m_ui->vbalDTabControl1->tabBar()->sizeHint().width() + 4, 0));
    const int tabWidth = std::max(twips::toPixelsX(kTabWidthTwips), content.width());
    const int tabHeight = std::max(twips::toPixelsY(kTabHeightTwips), content.height());
    const int stripWidth = twips::toPixelsX(kSideStripWidthTwips);
    m_ui->vbalDTabControl1->setGeometry(stripWidth, 0, tabWidth, tabHeight);
    // The pages are laid out for this size, so the window keeps it. Qt's size is the inner
    // one, without the title bar and borders that a stored Windows size counts in.
    setFixedSize(stripWidth + tabWidth, tabHeight);
    m_ui->picSideText->setGeometry(0, 0, stripWidth, height());
}

void frmSettings::selectPage(const QString& key) {
    for (int i = 0; i < m_ui->vbalDTabControl1->count(); ++i) {
        if (tabKey(i) == key) {
            m_ui->vbalDTabControl1->setCurrentIndex(i);
            return;
        }
    }
}

QString frmSettings::pageCaption(const QString& key) {
    for (const TabInfo& tab : kTabs)
        if (key == QLatin1String(tab.key))
            return QString::fromUtf8(tab.caption);
    return QString();
}

QString frmSettings::selectedPage() const {
    return tabKey(m_ui->vbalDTabControl1->currentIndex());
}

void frmSettings::showPage(const QString& key) {
    show();
    raise();
    activateWindow();
    selectPage(key);
    QCoreApplication::processEvents();
}

void frmSettings::showBalloonTip(const QString& control, int icon, const QString& title,
                                 const QString& text) {
    cTextBoxXP tip;
    tip.setTextBox(findChild<QWidget*>(control));
    tip.setBalloonTipIcon(icon);
    tip.setBalloonTipTitle(title);
    tip.setBalloonTipText(text);
    tip.ShowBalloonTip();
}

QString frmSettings::tabKey(int index) const {
    return m_ui->vbalDTabControl1->tabBar()->tabData(index).toString();
}

void frmSettings::vbalDTabControl1_TabClick(int index) {
    // Clicking the page already shown reloads it too; a change of page reloads through
    // vbalDTabControl1_TabSelected.
    if (index == m_ui->vbalDTabControl1->currentIndex() && tabKey(index) == kDefaultPathsKey)
        LoadDefaultPaths();
}

void frmSettings::vbalDTabControl1_TabSelected(int index) {
    if (index < 0)
        return;
    // Folders may have vanished from disk since the page was last filled.
    if (tabKey(index) == kDefaultPathsKey)
        LoadDefaultPaths();
    m_logo.setCaption(m_ui->vbalDTabControl1->tabText(index));
    m_logo.Draw();
}

void frmSettings::Unload() {
    m_bUnloading = true;
    close();
}

void frmSettings::closeEvent(QCloseEvent* event) {
    hide();
    if (!m_bUnloading) {
        // The user's close box only hides the window; every option stays as it is.
        event->ignore();
        return;
    }
    Form_Unload();
    event->accept();
}

void frmSettings::Form_Unload() {
    // A place moved onto a screen here is kept out of the store until the user moves the
    // window, so the stored one still holds when its screen is back.
    if (placeChangedByUser(*this, m_place))
        write(m_platform.store, stored::settingsWindow,
              WindowPlace{twips::fromPixelsY(y()), twips::fromPixelsX(x())});
    SaveDefaultPaths();
}

void frmSettings::keyPressEvent(QKeyEvent* event) {
    // Escape closes the window as its close box does, which only hides it.
    if (event->key() == Qt::Key_Escape && event->modifiers() == Qt::NoModifier) {
        close();
        return;
    }
    QWidget::keyPressEvent(event);
}

void frmSettings::resizeEvent(QResizeEvent* event) {
    QWidget::resizeEvent(event);
    Form_Resize();
}

void frmSettings::Form_Resize() {
    if (isMinimized())
        return;
    m_ui->picSideText->setGeometry(0, 0, m_ui->picSideText->width(), height());
    m_logo.Draw();
}

bool frmSettings::eventFilter(QObject* watched, QEvent* event) {
    if (numberFieldEvent(watched, event))
        return true;
    const bool bFolderList = watched == m_ui->vbalListDefPaths->viewport();
    const bool bZ26Box = watched == m_ui->txtDefPathz26;
    if (bFolderList || bZ26Box) {
        switch (event->type()) {
        case QEvent::DragEnter:
        case QEvent::DragMove: {
            auto* drag = static_cast<QDropEvent*>(event);
            if (firstDroppedPath(drag->mimeData()).isEmpty())
                drag->ignore();
            else
                drag->acceptProposedAction();
            return true;
        }
        case QEvent::Drop: {
            auto* drop = static_cast<QDropEvent*>(event);
            drop->acceptProposedAction();
            if (bFolderList)
                vbalListDefPaths_OLEDragDrop(drop->mimeData());
            else
                txtDefPathz26_OLEDragDrop(drop->mimeData());
            return true;
        }
        default:
            break;
        }
    } else if (watched == m_ui->vbalListDefPaths && event->type() == QEvent::KeyPress) {
        const int key = static_cast<QKeyEvent*>(event)->key();
        if (key == Qt::Key_Delete || key == Qt::Key_F5 || key == Qt::Key_Return ||
            key == Qt::Key_Enter) {
            vbalListDefPaths_KeyDown(key);
            return true;
        }
    } else if (event->type() == QEvent::Move || event->type() == QEvent::Resize) {
        if (watched == m_ui->comboVideoMode)
            m_ui->txtVidModeBalloon->setGeometry(m_ui->comboVideoMode->geometry());
        else if (watched == m_ui->ipc[3])
            m_ui->txtIPC4Balloon->setGeometry(m_ui->ipc[3]->geometry());
    }
    return QWidget::eventFilter(watched, event);
}

// ---- Default Paths page ----

QTreeWidgetItem* frmSettings::selectedRomRow() const {
    const QList<QTreeWidgetItem*> rows = m_ui->vbalListDefPaths->selectedItems();
    return rows.isEmpty() ? nullptr : rows.first();
}

void frmSettings::addRomRow(const QString& path, bool bEnabled) {
    const QSignalBlocker quiet(m_ui->vbalListDefPaths);
    auto* row = new QTreeWidgetItem(m_ui->vbalListDefPaths);
    row->setFlags(row->flags() | Qt::ItemIsUserCheckable);
    row->setText(0, path);
    row->setToolTip(0, Qt::convertFromPlainText(QDir::toNativeSeparators(path)));
    row->setTextAlignment(1, Qt::AlignRight | Qt::AlignVCenter);
    row->setCheckState(0, bEnabled ? Qt::Checked : Qt::Unchecked);
    // A folder not found (on a disk not plugged in, say) keeps its row, entry and flag
    // until the user removes it; it shows greyed with no files.
    if (!QFileInfo(path).isDir()) {
        for (const int column : {0, 1}) {
            row->setForeground(column, palette().brush(QPalette::Disabled, QPalette::Text));
            row->setToolTip(column, QStringLiteral("Folder not found"));
        }
        row->setText(1, QStringLiteral("0"));
    }
}

void frmSettings::recountRomRows() {
    // Counting lists every folder. While the window is hidden nobody sees the counts (and
    // at start-up the main list is listing the same folders), so they are made when the
    // window is next shown.
    if (!isVisible()) {
        m_bCountsPending = true;
        return;
    }
    m_bCountsPending = false;
    const QSignalBlocker quiet(m_ui->vbalListDefPaths);
    const bool bSubfolders = m_ui->chkROMSubfolders->isChecked();
    const FilePattern pattern(FileROM.pattern());
    for (int i = 0; i < m_ui->vbalListDefPaths->topLevelItemCount(); ++i) {
        QTreeWidgetItem* row = m_ui->vbalListDefPaths->topLevelItem(i);
        if (!bSubfolders) {
            FileROM.setPath(row->text(0));
            row->setText(1, QString::number(FileROM.ListCount()));
            continue;
        }
        qsizetype count = 0;
        for (const FolderListing& listing : listFolders({row->text(0)}, pattern, true))
            count += listing.names.size();
        row->setText(1, QString::number(count));
    }
    FileROM.takeNames(); // only the counts are kept, not a folder's names
}

void frmSettings::showEvent(QShowEvent* event) {
    QWidget::showEvent(event);
    if (m_bCountsPending)
        recountRomRows();
}

void frmSettings::LoadDefaultPaths() {
    {
        const QSignalBlocker quiet(m_ui->vbalListDefPaths);
        m_ui->vbalListDefPaths->clear();
    }
    // The stored flags come back with the rows; a reload that cleared them would make the
    // next save disable every folder.
    for (const RomFolder& folder : readRomFolders(m_platform.store))
        addRomRow(folder.path, folder.enabled);
    m_ui->chkROMSubfolders->setChecked(read(m_platform.store, stored::romSubfolders));
    // Counts every row with the page's pattern.
    txtDefPathFilter_Change();

    // Until an emulator is chosen the box offers the program's folder, where it may lie.
    const QString z26Path = read(m_platform.store, stored::z26Path);
    m_ui->txtDefPathz26->setText(
        z26PathForDisplay(z26Path.isEmpty() ? m_platform.programFolder : z26Path));
}

void frmSettings::SaveDefaultPaths() {
    std::vector<RomFolder> folders;
    folders.reserve(m_ui->vbalListDefPaths->topLevelItemCount());
    for (int i = 0; i < m_ui->vbalListDefPaths->topLevelItemCount(); ++i) {
        const QTreeWidgetItem* row = m_ui->vbalListDefPaths->topLevelItem(i);
        folders.push_back({row->text(0), row->checkState(0) == Qt::Checked});
    }
    writeRomFolders(m_platform.store, folders);
}

void frmSettings::txtDefPathFilter_Change() {
    const QString pattern = m_ui->txtDefPathFilter->text();
    FileROM.setPattern(pattern);
    recountRomRows();
    write(m_platform.store, stored::romFilter, pattern);
}

void frmSettings::chkROMSubfolders_Click() {
    write(m_platform.store, stored::romSubfolders, m_ui->chkROMSubfolders->isChecked());
    recountRomRows();
}

void frmSettings::vbalListDefPaths_ItemChanged(QTreeWidgetItem*, int column) {
    // A folder switched on or off reaches the store at once, so the main list's next
    // refresh follows it and a reload of the page does not undo it.
    if (column == 0)
        SaveDefaultPaths();
}

void frmSettings::AddRomFolder(const QString& path, bool bArchive) {
    if (bArchive) {
        m_platform.dialogs.MsgBox(this, QStringLiteral(".rar files aren't supported yet"),
                                  MsgButtons::Ok, MsgIcon::None);
    } else if (!path.isEmpty() && QFileInfo(path).isDir()) {
        const QTreeWidget* rows = m_ui->vbalListDefPaths;
        for (int i = 0; i < rows->topLevelItemCount(); ++i) {
            const QString listed = rows->topLevelItem(i)->text(0);
            if (sameFolder(listed, path)) {
                m_platform.dialogs.MsgBox(this,
                                          QDir::toNativeSeparators(listed) +
                                              QStringLiteral(" is already in the list."),
                                          MsgButtons::Ok, MsgIcon::Information);
                return;
            }
        }
        // New folders are enabled; the reload below counts the files.
        addRomRow(path, true);
    } else {
        m_platform.dialogs.MsgBox(
            this, QStringLiteral("That doesn't appear to be a valid folder.\nChoose another one."),
            MsgButtons::Ok, MsgIcon::None, QStringLiteral("Add Folders Not Files."));
    }
    SaveDefaultPaths();
    LoadDefaultPaths();
}

void frmSettings::SetZ26Path(const QString& path) {
    const QString executable = completeZ26Path(path);
    const QFileInfo found(executable);
    if (found.isFile() && found.isExecutable()) {
        m_ui->txtDefPathz26->setText(executable);
        write(m_platform.store, stored::z26Path, executable);
        return;
    }
    // A file that is there but cannot be run (a text file, a z26 without its execute
    // permission, a folder named z26) is named, so the user sees which one was refused.
    if (found.exists() || QFileInfo(path).isFile()) {
        m_platform.dialogs.MsgBox(
            this,
            QDir::toNativeSeparators(found.exists() ? executable : path) +
                QStringLiteral(" is not a program lum can start.\nChoose the z26 program."),
            MsgButtons::Ok, MsgIcon::Exclamation, QStringLiteral("Not a Program"));
        return;
    }
    m_platform.dialogs.MsgBox(
        this, z26FileName() + QStringLiteral(" doesn't exist in that path. \nChoose another one."),
        MsgButtons::Ok, MsgIcon::None, QStringLiteral("Non-z26 Folder Chosen."));
}

void frmSettings::cmdAddZ26Path_Click() {
    FileDialogRequest request;
    request.title = QStringLiteral("Choose z26 path");
    request.initialFolder = m_platform.programFolder;
    request.filter =
        QStringLiteral("z26 executable (%1)|%1|All Files (*.*)|*.*").arg(z26FileName());
    request.filterIndex = 1;
    request.flags = kFlagPathMustExist | kFlagFileMustExist;
    const QString chosen = m_platform.dialogs.ShowOpen(this, request);
    if (!chosen.isEmpty())
        SetZ26Path(chosen);
}

void frmSettings::mnuROMSAdd_Click() {
    // A folder chooser: the folder list takes folders, never files.
    const QString chosen = m_platform.dialogs.ShowFolder(this, QStringLiteral("Choose ROMs path"),
                                                         m_platform.programFolder);
    if (!chosen.isEmpty())
        AddRomFolder(chosen, false);
}

void frmSettings::mnuROMSRemove_Click() {
    QTreeWidgetItem* row = selectedRomRow();
    if (row == nullptr)
        return;
    const int index = m_ui->vbalListDefPaths->indexOfTopLevelItem(row);
    const QString path = row->text(0);
    const MsgResult answer = m_platform.dialogs.MsgBox(
        this,
        QStringLiteral("Are you sure you want to remove ") + QDir::toNativeSeparators(path) +
            QStringLiteral(" from the list?"),
        MsgButtons::YesNoCancel, MsgIcon::Question, QStringLiteral("Remove Path?"));
    if (answer != MsgResult::Yes)
        return;
    // The question let other events run; remove the row only if it is still the one asked about.
    QTreeWidgetItem* asked = m_ui->vbalListDefPaths->topLevelItem(index);
    if (asked == nullptr || asked->text(0) != path)
        return;
    {
        const QSignalBlocker quiet(m_ui->vbalListDefPaths);
        delete asked;
    }
    SaveDefaultPaths();
    LoadDefaultPaths();
}

void frmSettings::mnuROMSRefresh_Click() {
    SaveDefaultPaths();
    LoadDefaultPaths();
}

void frmSettings::vbalListDefPaths_KeyDown(int key) {
    switch (key) {
    case Qt::Key_Delete:
        mnuROMSRemove_Click();
        break;
    case Qt::Key_F5:
        mnuROMSRefresh_Click();
        break;
    case Qt::Key_Return:
    case Qt::Key_Enter:
        if (QTreeWidgetItem* row = selectedRomRow())
            row->setCheckState(0, row->checkState(0) == Qt::Checked ? Qt::Unchecked : Qt::Checked);
        break;
    default:
        break;
    }
}

void frmSettings::vbalListDefPaths_MouseDown(Qt::MouseButton button, const QPoint& pos) {
    if (button != Qt::RightButton)
        return;
    const QTreeWidgetItem* row = selectedRomRow();
    m_ui->mnuROMSRemove->setVisible(row != nullptr && !row->text(0).isEmpty());
    m_ui->mnuROMSPopup->popup(m_ui->vbalListDefPaths->viewport()->mapToGlobal(pos));
}

void frmSettings::vbalListDefPaths_OLEDragDrop(const QMimeData* data) {
    const QString path = firstDroppedPath(data);
    if (!path.isEmpty())
        AddRomFolder(path, isArchiveName(path));
}

void frmSettings::txtDefPathz26_OLEDragDrop(const QMimeData* data) {
    const QString path = firstDroppedPath(data);
    if (!path.isEmpty())
        SetZ26Path(path);
}
