#include "about/frmAbout.h"

#include "about/AboutArt.h"
#include "about/AboutRules.h"
#include "about/SysInfo.h"
#include "about/UpdateCheck.h"
#include "platform/Downloader.h"
#include "platform/Platform.h"
#include "platform/Shell.h"
#include "platform/WebAddresses.h"
#include "ui/Twips.h"

#include <QCloseEvent>
#include <QFrame>
#include <QGridLayout>
#include <QHBoxLayout>
#include <QLabel>
#include <QMouseEvent>
#include <QPainter>
#include <QPointer>
#include <QPushButton>
#include <QVBoxLayout>

#include <utility>

namespace {

constexpr QRgb kGreen = qRgb(0, 255, 0);
constexpr QRgb kYellow = qRgb(255, 255, 0);
constexpr QRgb kEmailNormal = qRgb(0, 255, 255);
constexpr QRgb kEmailHover = qRgb(78, 136, 255);

constexpr double kProgramPoints = 29.25;

// A named font with the system's sans-serif face standing in when it is not installed.
QFont namedFont(const QString& family, double points, bool bold) {
    QFont font(family);
    font.setStyleHint(QFont::SansSerif);
    font.setPointSizeF(points);
    font.setBold(bold);
    return font;
}

void setTextColour(QLabel* label, const QColor& colour) {
    QPalette palette = label->palette();
    palette.setColor(QPalette::WindowText, colour);
    label->setPalette(palette);
}

QLabel* makeLabel(QWidget* parent, const char* name) {
    auto* label = new QLabel(parent);
    label->setObjectName(QLatin1String(name));
    return label;
}

QPushButton* makeButton(QWidget* parent, const char* name, const QString& caption) {
    auto* button = new QPushButton(caption, parent);
    button->setObjectName(QLatin1String(name));
    return button;
}

QFrame* makeLine(QWidget* parent) {
    auto* line = new QFrame(parent);
    line->setObjectName(QStringLiteral("Line1"));
    line->setFrameShape(QFrame::HLine);
    line->setFrameShadow(QFrame::Plain);
    QPalette palette = line->palette();
    palette.setColor(QPalette::WindowText, QColor(kGreen).darker(160));
    line->setPalette(palette);
    return line;
}

// Mirrors, packagers and tests choose another update server through the environment.
QString updateServerBase() {
    QString base = qEnvironmentVariable("LUM_UPDATE_URL").trimmed();
    while (base.endsWith(u'/'))
        base.chop(1);
    return base.isEmpty() ? QString(web::kUpdateServer) : base;
}

} // namespace

frmAbout::frmAbout(Platform& platform, QWidget* parent, QString updateServer)
    : QDialog(parent), m_platform(platform),
      m_updateServer(updateServer.isEmpty() ? updateServerBase() : std::move(updateServer)) {
    setObjectName(QStringLiteral("frmAbout"));
    setWindowTitle(QStringLiteral("About"));
    setModal(false);
    // Whichever way it closes (OK, Esc, the close box), the window goes away.
    connect(this, &QDialog::finished, this, &QObject::deleteLater);
    createControls();
    Form_Load();
}

frmAbout::~frmAbout() = default;

void frmAbout::createControls() {
    Image1 = QPixmap::fromImage(aboutBackgroundTile());
    setMouseTracking(true);

    lblCorwen = makeLabel(this, "lblCorwen");
    lblCorwen->setText(QStringLiteral("Corwen's"));
    lblCorwen->setFont(namedFont(QStringLiteral("Arial"), 18, true));
    lblProgram = makeLabel(this, "lblProgram");
    lblProgram->setFont(namedFont(QStringLiteral("Arial"), kProgramPoints, true));
    lblVersion = makeLabel(this, "lblVersion");
    lblVersion->setText(QStringLiteral("Version x.x.x"));
    lblMain = makeLabel(this, "lblMain");
    lblMain->setWordWrap(true);
    lblEmail = makeLabel(this, "lblEmail");
    lblEmail->setText(QString(web::kSupportEmail));
    QFont emailFont = namedFont(QStringLiteral("MS Sans Serif"), 8.25, false);
    emailFont.setUnderline(true);
    lblEmail->setFont(emailFont);
    lblEmail->setCursor(Qt::PointingHandCursor);
    lblEmail->setMouseTracking(true);
    lblEmail->installEventFilter(this);
    setTextColour(lblEmail, kEmailNormal);

    Picture1 = makeLabel(this, "Picture1");
    Picture1->setPixmap(QPixmap::fromImage(aboutPicture()));
    Picture1->setFixedSize(Picture1->pixmap().size());
    Line1[0] = makeLine(this);
    Line1[1] = makeLine(this);

    cmdOK = makeButton(this, "cmdOK", QStringLiteral("&OK"));
    cmdSysInfo = makeButton(this, "cmdSysInfo", QStringLiteral("&System Info"));
    cmdUpdate = makeButton(this, "cmdUpdate", QStringLiteral("Check for &Update"));
    cmdForum = makeButton(this, "cmdForum", QStringLiteral("Goto &Forum"));
    cmdWeb = makeButton(this, "cmdWeb", QStringLiteral("Goto &Webpage"));
    cmdDonate = makeButton(this, "cmdDonate", QStringLiteral("&Donate"));
    cmdOK->setDefault(true);

    auto* text = new QVBoxLayout;
    text->setSpacing(4);
    text->addWidget(lblCorwen);
    text->addWidget(lblProgram);
    text->addWidget(lblVersion);
    text->addSpacing(4);
    text->addWidget(Line1[0]);
    text->addSpacing(4);
    text->addWidget(lblMain);
    text->addWidget(lblEmail);
    text->addStretch(1);

    auto* top = new QHBoxLayout;
    top->setSpacing(16);
    top->addWidget(Picture1, 0, Qt::AlignTop);
    top->addLayout(text, 1);

    auto* buttons = new QGridLayout;
    buttons->addWidget(cmdSysInfo, 0, 0);
    buttons->addWidget(cmdUpdate, 0, 1);
    buttons->addWidget(cmdForum, 0, 2);
    buttons->addWidget(cmdWeb, 1, 0);
    buttons->addWidget(cmdDonate, 1, 1);
    buttons->addWidget(cmdOK, 1, 2);

    auto* outer = new QVBoxLayout(this);
    outer->setContentsMargins(14, 14, 14, 14);
    outer->setSpacing(10);
    outer->addLayout(top, 1);
    outer->addWidget(Line1[1]);
    outer->addLayout(buttons);
    outer->setSizeConstraint(QLayout::SetFixedSize);

    connect(cmdOK, &QPushButton::clicked, this, &frmAbout::cmdOK_Click);
    connect(cmdSysInfo, &QPushButton::clicked, this, &frmAbout::cmdSysInfo_Click);
    connect(cmdUpdate, &QPushButton::clicked, this, &frmAbout::cmdUpdate_Click);
    connect(cmdForum, &QPushButton::clicked, this, &frmAbout::cmdForum_Click);
    connect(cmdWeb, &QPushButton::clicked, this, &frmAbout::cmdWeb_Click);
    connect(cmdDonate, &QPushButton::clicked, this, &frmAbout::cmdDonate_Click);
}

void frmAbout::Form_Load() {
    m_bForumRequest = false;
    if (QWidget* owner = parentWidget())
        setWindowIcon(owner->window()->windowIcon());

    const ProductVersion product = thisProduct();
    lblProgram->setText(product.name);
    QFont font = lblProgram->font();
    font.setPointSizeF(shrinkToFit(font, product.name, twips::toPixelsX(kProgramLabelMaxTwips)));
    lblProgram->setFont(font);

    m_sVersion = versionText(product);
    lblVersion->setText(QStringLiteral("Version ") + m_sVersion);

    setTextColour(lblCorwen, kGreen);
    setTextColour(lblProgram, kGreen);
    setTextColour(lblVersion, kGreen);
    setTextColour(lblMain, kYellow);
    lblMain->setText(QStringLiteral(
        "This program is freeware: use it and pass it on as you like. If you enjoy it, "
        "please consider a donation to help its development along. Questions, bug reports "
        "and ideas are welcome at:"));
    lblMain->setMinimumWidth(twips::toPixelsX(kProgramLabelMaxTwips));
}

void frmAbout::paintEvent(QPaintEvent*) {
    Form_Paint();
}

void frmAbout::Form_Paint() {
    QPainter painter(this);
    for (const QPoint& origin : tileOrigins(size(), Image1.deviceIndependentSize().toSize()))
        painter.drawPixmap(origin, Image1);
}

void frmAbout::mouseMoveEvent(QMouseEvent* event) {
    Form_MouseMove(event->position().toPoint());
    QDialog::mouseMoveEvent(event);
}

void frmAbout::Form_MouseMove(const QPoint& position) {
    // Only the window's own surface resets the colour; moves over the other controls
    // reach here too and must not.
    if (!childAt(position))
        setTextColour(lblEmail, kEmailNormal);
}

bool frmAbout::eventFilter(QObject* watched, QEvent* event) {
    if (watched == lblEmail) {
        if (event->type() == QEvent::MouseMove) {
            lblEmail_MouseMove();
        } else if (event->type() == QEvent::MouseButtonRelease &&
                   static_cast<QMouseEvent*>(event)->button() == Qt::LeftButton &&
                   lblEmail->rect().contains(
                       static_cast<QMouseEvent*>(event)->position().toPoint())) {
            lblEmail_Click();
            return true;
        }
    }
    return QDialog::eventFilter(watched, event);
}

void frmAbout::lblEmail_MouseMove() {
    setTextColour(lblEmail, kEmailHover);
}

void frmAbout::lblEmail_Click() {
    m_platform.shell.OpenUrl(
        mailtoAddress(QString(web::kSupportEmail), thisProduct().name, m_sVersion));
}

void frmAbout::cmdWeb_Click() {
    m_platform.shell.OpenUrl(QString(web::kLumHomePage));
}

void frmAbout::cmdDonate_Click() {
    m_platform.shell.OpenUrl(donationAddress(QString(web::kDonationService),
                                             QString(web::kDonationEmail),
                                             QString(web::kDonationSiteName)));
}

void frmAbout::cmdOK_Click() {
    close();
}

void frmAbout::cmdSysInfo_Click() {
    StartSysInfo();
}

void frmAbout::StartSysInfo() {
    ::StartSysInfo(m_platform, this);
}

bool frmAbout::GetKeyValue(quint32 KeyRoot, const QString& KeyName, const QString& SubKeyRef,
                           QString& KeyVal) {
    return ::GetKeyValue(m_platform.registry, KeyRoot, KeyName, SubKeyRef, KeyVal);
}

bool frmAbout::DownloadFile(const QString& URL, const QString& LocalFilename) {
    return m_platform.network.DownloadFile(URL, LocalFilename);
}

void frmAbout::cmdUpdate_Click() {
    runUpdateCheck();
}

void frmAbout::cmdForum_Click() {
    m_bForumRequest = true;
    runUpdateCheck();
}

void frmAbout::runUpdateCheck() {
    if (m_bChecking)
        return;
    m_bChecking = true;
    // The owner may still take the window away while a download waits.
    const QPointer<frmAbout> self(this);
    UpdateCheck check(m_platform, this, m_updateServer);
    const UpdateCheck::Outcome outcome = check.Run(m_bForumRequest);
    if (!self)
        return;
    m_bChecking = false;
    m_bForumRequest = false;
    if (outcome == UpdateCheck::Outcome::EndProgram)
        emit endProgramRequested();
}

void frmAbout::closeEvent(QCloseEvent* event) {
    if (m_bChecking) {
        event->ignore();
        return;
    }
    QDialog::closeEvent(event);
}
