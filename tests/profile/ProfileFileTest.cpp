// The text of a profile file: the meaning of its lines, and the handling of incomplete ones.
#include "CProfileTexts.h"
#include "ProfileFixture.h"

#include <filesystem>

#include <tuple>

namespace gw {
namespace {

// Returns a line as "12 source>target 1,2,3 4,5,6", "12 rate 30" or "12 at 1,2,3", starting with its line
// number.
std::string Describe(const ProfileLine& line)
{
    const auto three = [](auto a, auto b, auto c) {
        return std::to_string(int(a)) + ',' + std::to_string(int(b)) + ',' + std::to_string(int(c));
    };
    std::string number = std::to_string(line.line) + ' ';
    if (line.kind == EProfileLine::FrameRate)
        return number + "rate " + std::to_string(line.frameRate);
    if (line.kind == EProfileLine::Position)
        return number + "at " + three(line.position.x, line.position.y, line.position.z);
    const auto [rotation, axes] = line.Numbers();
    return number.append(line.source).append(">").append(line.target) + ' ' +
           three(rotation[0], rotation[1], rotation[2]) + ' ' + three(axes[0], axes[1], axes[2]);
}

// Returns all lines after the name, each followed by "; ".
std::string ReadAll(std::string_view text)
{
    CProfileReader reader(text);
    std::string lines;
    ProfileLine line;
    while (reader.Next(line))
        lines += Describe(line) + "; ";
    return lines;
}

} // namespace

TEST(CProfileTexts, ThePackStandsForFilesThatAreAsTheyWere)
{
    using namespace std::chrono_literals;
    const std::string pack = "A.prf 8\npacked A"
                             "B.prf 8\npacked B";
    const struct
    {
        const char* what;
        std::string pack, a;
        std::chrono::seconds age; // of A.prf, relative to the pack's time
        const char* names;
    } rows[] = {
        {"as packed", pack, "edited A", 10s, "packed A|packed B|"},
        {"edited since", pack, "edited A", -10s, "edited A|packed B|"},
        {"of another size", pack, "another A", 10s, "another A|packed B|"},
        {"gone", pack, "", 0s, "packed B|"},
        {"no pack", "", "edited A", 10s, "edited A|edited B|"},
        {"a pack that was cut", pack.substr(0, 20), "edited A", 10s, "packed A|edited B|"},
    };
    for (const auto& row : rows)
    {
        SCOPED_TRACE(row.what);
        const CTempFolder folder;
        WriteBytes(folder.Path("B.prf"), "edited B");
        WriteBytes(folder.Path(kProfilePack), row.pack);
        const auto time = std::filesystem::last_write_time(folder.Path(kProfilePack));
        std::filesystem::last_write_time(folder.Path("B.prf"), time);
        if (!row.a.empty())
        {
            WriteBytes(folder.Path("A.prf"), row.a);
            std::filesystem::last_write_time(folder.Path("A.prf"), time - row.age);
        }
        std::string names;
        for (const CProfileTexts texts(folder.Path()); const CProfileTexts::Entry& entry : texts.Entries())
        {
            EXPECT_EQ(entry.text, entry.name);
            names += entry.name + '|';
        }
        EXPECT_EQ(names, row.names);
    }
}

TEST(ProfileReader, LinesSayWhatTheirFormSays)
{
    const std::tuple<const char*, std::string, std::string> rows[] = {
        {"nothing but a name", "Only a name", ""},
        {"a name and its end", "Name\n", ""},
        {"keywords in any case", "N\nFRAMERATE 60\nposition 1 -2 3.9\n", "2 rate 60; 3 at 1,-2,3; "},
        {"a whole mapping row", "N\nA <---> Head 1,-2,3,-3,2,1\n", "2 A>Head 1,-2,3 -3,2,1; "},
        {"any second token", "N\nA = Head 1,2,3,1,2,3\n", "2 A>Head 1,2,3 1,2,3; "},
        {"one number alone is a rotation X", "N\nA <---> B 10\n", "2 A>B 10,0,0 1,2,3; "},
        {"rotation without axes", "N\nA <---> B 10,20,30\n", "2 A>B 10,20,30 1,2,3; "},
        {"some of the axes", "N\nA <---> B 1,2,3,-2\n", "2 A>B 1,2,3 -2,2,3; "},
        {"dotted mapping row", "N\nA <---> B .-1,3,2\n", "2 A>B 0,0,0 -1,3,2; "},
        {"a dot alone", "N\nA <---> B .\n", "2 A>B 0,0,0 1,2,3; "},
        {"a comma first ends the list", "N\nA <---> B 5,,7,1\n", "2 A>B 5,0,0 1,2,3; "},
        {"words are 0", "N\nA <---> B x,y,z\n", "2 A>B 0,0,0 1,2,3; "},
        {"dotted fixed row", "N\n* Head . .-1,3,2\n", "2 [FIXED]>Head 0,0,0 -1,3,2; "},
        {"undotted fixed row", "N\n* Head . 4,5,6,3,2,1\n", "2 [FIXED]>Head 4,5,6 3,2,1; "},
        {"a blank line repeats", "N\nA <---> B 1,2,3\n\n", "2 A>B 1,2,3 1,2,3; 3 A>B 1,2,3 1,2,3; "},
        {"a short line borrows the tail", "N\nA <---> B 9\nC <--->\n",
         "2 A>B 9,0,0 1,2,3; 3 C>B 9,0,0 1,2,3; "},
        {"a fixed row borrows too", "N\nA <---> B 9\n* C\n", "2 A>B 9,0,0 1,2,3; 3 [FIXED]>C 9,0,0 1,2,3; "},
        {"nothing to borrow yet", "N\n\n", "2 > 0,0,0 1,2,3; "},
        {"CR LF, no last line end", "N\r\nFrameRate 60\r\nA x B 1", "2 rate 60; 3 A>B 1,0,0 1,2,3; "},
        {"a byte order mark", "\xef\xbb\xbfN\nFrameRate 60\n", "2 rate 60; "},
    };
    for (const auto& [what, text, lines] : rows)
        EXPECT_EQ(ReadAll(text), lines) << what;
}

TEST(ProfileReader, BuffersCutLinesAndTokens)
{
    const std::string upTo1024(1017, ' '); // the rest after "A x B 1"
    const std::string b300(300, 'B');
    EXPECT_EQ(ReadAll("N\nA x B 1" + upTo1024 + "\n"), "2 A>B 1,0,0 1,2,3; ") << "not a blank line more";
    EXPECT_EQ(ReadAll("N\nA x B 1" + upTo1024 + "C x D 2\n"), "2 A>B 1,0,0 1,2,3; 2 C>D 2,0,0 1,2,3; ");
    EXPECT_EQ(ReadAll("N\nA x " + b300 + " 1\n"), "2 A>" + b300.substr(0, 255) + " 1,0,0 1,2,3; ");
    EXPECT_EQ(ReadAll(std::string("N\nA x B 1\0,2\nFrameRate 9\n", 24)), "2 A>B 1,0,0 1,2,3; 3 rate 9; ");
}

TEST(ProfileReader, NameIsTheFirstLineWithoutItsEnd)
{
    const CTempFolder folder;
    const std::tuple<const char*, std::string, std::string> rows[] = {
        {"blanks inside stay, those at the end go", "My own  one \t \r\nFrameRate 30\n", "My own  one"},
        {"byte order mark", "\xef\xbb\xbfName\n", "Name"},
        {"empty file", "", ""},
        {"empty line", "\nFrameRate 30\n", ""},
    };
    for (const auto& [what, text, name] : rows)
    {
        WriteBytes(folder.Path("a.prf"), text);
        EXPECT_EQ(ReadProfileName(folder.Path("a.prf")), name) << what;
    }
    WriteBytes(folder.Path("a.prf"), std::string(5000, 'n'));
    EXPECT_EQ(ReadProfileName(folder.Path("a.prf")), std::string(1024, 'n')) << "rubbish without a line end";
    EXPECT_EQ(ReadProfileName(folder.Path("none.prf")), "");
    EXPECT_EQ(ReadProfileName(folder.Path("")), "") << "a folder";
}

TEST(ProfileReader, EveryPrefixIsReadToItsEnd)
{
    const std::string whole =
        "\xef\xbb\xbfN\r\nFrameRate 60\nPosition 1 2 3\nA <---> B 1,2,3,-3,2,1\n* C . .1,2,3\n";
    for (size_t size = 0; size <= whole.size(); ++size)
    {
        const std::vector<char> cut(whole.begin(),
                                    whole.begin() + std::ptrdiff_t(size)); // its own buffer
        EXPECT_LE(ReadAll({cut.data(), cut.size()}).size(), 200u);
    }
    EXPECT_EQ(ReadAll("N\nA x B 99999999999999999999,-99999999999999999999\n"),
              "2 A>B 2147483647,-2147483648,0 1,2,3; ");
}

TEST(ProfileReader, TextThatIsNoProfileIsRefused)
{
    const CTempFolder folder;
    std::string text = "untouched";
    WriteBytes(folder.Path("long.prf"), std::string(kProfileByteLimit + 1, ' '));
    for (const char* name : {"long.prf", "none.prf", ""})
        EXPECT_FALSE(ReadProfileText(folder.Path(name), text)) << name;
    EXPECT_EQ(text, "untouched");
}

TEST(AxisCodes, MatrixHasOneColumnForEachRow)
{
    EXPECT_EQ(AxisMatrix(kNeutralAxes), kMat3Identity);
    EXPECT_EQ(AxisMatrix({-1, 3, 2}), (Mat3{{-1, 0, 0, 0, 0, 1, 0, 1, 0}}));
    EXPECT_EQ(AxisMatrix({1, -3, 3}), (Mat3{{1, 0, 0, 0, 0, -1, 0, 0, 1}}))
        << "no check rejects two equal axes";
}

} // namespace gw
