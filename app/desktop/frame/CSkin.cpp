// Reads a skin folder: the layout of the face line by line, its texts, style sheet and icons. A skin without
// all children that the program needs is refused with a description of the problem.

#include "CSkin.h"

#include "CMappedFile.h"
#include "IniText.h"
#include "Numbers.h"
#include "Paths.h"
#include "QtText.h"
#include "SvgIcon.h"
#include "Text.h"

#include <QPointF>
#include <QRegularExpression>
#include <QSizeF>
#include <algorithm>

namespace gw {

namespace {

constexpr const char* kLayoutFile = "bvh.cnt";
constexpr const char* kTextFile = "bvh.ini";
constexpr const char* kStyleFile = "bvh.qss";
constexpr std::string_view kTextSection = "bvh";
constexpr size_t kFileByteLimit = 1 << 20;
constexpr int kLongestSide = 4096;

constexpr std::string_view kKinds[] = {
    "picture", "text", "caption", "value", "button", "primary", "toggle",
    "view",    "bar",  "marks",   "combo", "arrow",  "line",
};

// The children that the program looks up by name.
constexpr std::string_view kNeededChildren[] = {
    "#title",  "#cnt1", "#cnt2", "|playbar", "#format", "pull", "%adv",    "del",      "open",
    "convert", "apply", "help",  "close",    "exit",    "play", "stop",    "back",     "end",
    "fback",   "fend",  "play1", "stop1",    "start1",  "end1", "PreFrm1", "NextFrm1",
};

constexpr int kIconSide = 20;
constexpr double kSmallestScale = 0.5;

// Scales all lengths of more than two pixels, because thinner lines would vanish. Rounding down keeps radii
// within half the sides; the toolkit does not round corners otherwise.
QString ScaledStyle(const QString& style, double scale)
{
    static const QRegularExpression length(QStringLiteral("(\\d+)px"));
    QString scaled;
    qsizetype end = 0;
    for (auto found = length.globalMatch(style); found.hasNext();)
    {
        const QRegularExpressionMatch match = found.next();
        const int pixels = match.captured(1).toInt();
        scaled += style.mid(end, match.capturedStart() - end) +
                  QString::number(pixels > 2 ? static_cast<int>(scale * pixels) : pixels) +
                  QStringLiteral("px");
        end = match.capturedEnd();
    }
    return scaled + style.mid(end);
}

bool IsSide(int pixels)
{
    return pixels > 0 && pixels <= kLongestSide;
}

// Returns a child's name without the character for its kind.
std::string_view BareName(std::string_view child)
{
    return child.substr(child.find_first_of("#|%") == 0 ? 1 : 0);
}

// Parses "kind name left top width height [picture [picture]]".
bool ReadChild(std::string_view line, SkinChild& child)
{
    child.kind = NextWord(line);
    child.name = NextWord(line);
    int number[4] = {};
    for (int& value : number)
    {
        if (!ScanInt(NextWord(line), value))
            return false;
    }
    child.place = QRect(number[0], number[1], number[2], number[3]);
    child.icon = NextWord(line);
    child.secondIcon = NextWord(line);
    return std::ranges::find(kKinds, child.kind) != std::end(kKinds) && IsSide(number[2]) &&
           IsSide(number[3]);
}

bool ReadSize(std::string_view line, QSize& size)
{
    NextWord(line);
    int width = 0;
    int height = 0;
    const bool read = ScanInt(NextWord(line), width) && ScanInt(NextWord(line), height);
    size = QSize(width, height);
    return read && IsSide(width) && IsSide(height);
}

} // namespace

bool CSkin::Load(const std::string& folder, std::string& problem)
{
    m_kFolder = WithSeparator(folder);
    std::string layout;
    std::string style;
    if (!ReadFile(kLayoutFile, layout, problem) || !ReadFile(kTextFile, m_kTexts, problem) ||
        !ReadFile(kStyleFile, style, problem) || !ReadLayout(layout, problem) || !HasAllParts(problem))
        return false;
    // Paths in style sheets are relative to the current folder only.
    m_kStyleSheet =
        ToQString(style).replace(QLatin1String("url(@/"), QLatin1String("url(") + ToQString(m_kFolder));
    return true;
}

void CSkin::ShrinkTo(const QSize& screen)
{
    const double fit = std::min(static_cast<double>(screen.width()) / m_kSize.width(),
                                static_cast<double>(screen.height()) / m_kSize.height());
    if (!(fit < 1.0))
        return;
    m_dScale = std::max(fit, kSmallestScale);
    m_kStyleSheet = ScaledStyle(m_kStyleSheet, m_dScale);
    for (SkinChild& child : m_kChildren)
    {
        const QPointF corner = QPointF(child.place.topLeft()) * m_dScale;
        child.place = QRect(corner.toPoint(), (QSizeF(child.place.size()) * m_dScale).toSize());
        child.place.setSize(child.place.size().expandedTo({1, 1}));
    }
    m_kSize = (QSizeF(m_kSize) * m_dScale).toSize();
}

int CSkin::IconSide() const
{
    return qRound(kIconSide * m_dScale);
}

bool CSkin::ReadFile(const char* name, std::string& text, std::string& problem) const
{
    CMappedFile file;
    if (file.Open(m_kFolder + name) != EFailure::None || file.Text().size() > kFileByteLimit)
    {
        problem = "The file \"" + m_kFolder + name + "\" is missing or cannot be read.";
        return false;
    }
    text = file.Text();
    return true;
}

bool CSkin::ReadLayout(std::string_view text, std::string& problem)
{
    m_kChildren.clear();
    m_kSize = QSize();
    std::string_view line;
    for (int number = 1; NextLine(text, line); ++number)
    {
        std::string_view rest = line;
        const std::string_view word = NextWord(rest);
        if (word.empty() || word.front() == ';')
            continue;
        SkinChild child;
        if (word == "size" ? ReadSize(line, m_kSize) : ReadChild(line, child))
        {
            if (word != "size")
                m_kChildren.push_back(std::move(child));
            continue;
        }
        problem =
            m_kFolder + kLayoutFile + ":" + std::to_string(number) + ": invalid line: " + Printable(line);
        return false;
    }
    return true;
}

bool CSkin::HasAllParts(std::string& problem) const
{
    if (m_kSize.isEmpty())
    {
        problem = m_kFolder + kLayoutFile + " has no size.";
        return false;
    }
    for (const std::string_view name : kNeededChildren)
    {
        if (std::ranges::find(m_kChildren, name, &SkinChild::name) == m_kChildren.end())
        {
            problem = m_kFolder + kLayoutFile + " has no child \"" + std::string(name) + "\".";
            return false;
        }
    }
    for (const SkinChild& child : m_kChildren)
    {
        for (const std::string& icon : {child.icon, child.secondIcon})
        {
            if (icon.empty() || FileExists(IconPath(icon)))
                continue;
            problem = "The picture \"" + IconPath(icon) + "\" is missing.";
            return false;
        }
    }
    return true;
}

QString CSkin::Text(std::string_view child, std::string_view aspect) const
{
    const std::string key = std::string(BareName(child)) + std::string(aspect);
    return ToQString(FindIniValue(m_kTexts, kTextSection, key).value_or(std::string()));
}

std::string CSkin::IconPath(const std::string& name) const
{
    return WithSeparator(m_kFolder + "icons") + name + ".svg";
}

QIcon CSkin::Icon(const std::string& name) const
{
    return name.empty() ? QIcon() : SvgIcon(ToQString(IconPath(name)));
}

} // namespace gw
