// A joint's name is split into words of a small lexicon. Each word is a set of features ("calf" is lower and
// leg, and so is "LoLeg"), the name is the union of its words' features, and a table lists which unions name
// a joint. A word outside the lexicon makes the whole name unknown, so twist bones, end joints, fingers and
// faces need no list.

#include "JointWords.h"

#include "Numbers.h"
#include "Text.h"

#include <algorithm>
#include <array>
#include <optional>
#include <span>
#include <string>

namespace gw {

namespace {

enum EFeature : uint32_t
{
    kNothing = 0,
    kLeft = 1u << 0,
    kRight = 1u << 1,
    kUp = 1u << 2,
    kLow = 1u << 3,
    kMid = 1u << 4,
    kFore = 1u << 5,
    kBase = 1u << 6,
    kCenter = 1u << 7,
    kJoint = 1u << 8,
    kHip = 1u << 9,
    kPelvis = 1u << 10,
    kSpine = 1u << 11,
    kTorso = 1u << 12,
    kNeck = 1u << 13,
    kHead = 1u << 14,
    kEndSite = 1u << 15,
    kClavicle = 1u << 16,
    kShoulder = 1u << 17,
    kArm = 1u << 18,
    kWrist = 1u << 19,
    kHand = 1u << 20,
    kLeg = 1u << 21,
    kAnkle = 1u << 22,
    kFoot = 1u << 23,
    kToe = 1u << 24,
};

struct Word
{
    std::string_view text;
    uint32_t features;
};

constexpr Word kLexicon[] = {
    {"left",     kLeft       },
    {"lft",      kLeft       },
    {"right",    kRight      },
    {"rgt",      kRight      },
    {"up",       kUp         },
    {"upper",    kUp         },
    {"lo",       kLow        },
    {"low",      kLow        },
    {"lower",    kLow        },
    {"mid",      kMid        },
    {"middle",   kMid        },
    {"fore",     kFore       },
    {"base",     kBase       },
    {"center",   kCenter     },
    {"centre",   kCenter     },
    {"joint",    kJoint      },
    {"jnt",      kJoint      },
    {"bone",     kNothing    },
    {"bend",     kNothing    }, // the half of a limb bone that does not twist
    {"to",       kNothing    },
    {"hip",      kHip        },
    {"hips",     kHip        },
    {"pelvis",   kPelvis     },
    {"spine",    kSpine      },
    {"back",     kSpine      },
    {"chest",    kSpine      },
    {"thorax",   kSpine      },
    {"rib",      kSpine      },
    {"ribs",     kSpine      },
    {"ribcage",  kSpine      },
    {"abdomen",  kSpine      },
    {"ab",       kSpine      },
    {"navel",    kSpine      },
    {"waist",    kSpine      },
    {"torso",    kTorso      },
    {"neck",     kNeck       },
    {"atlas",    kNeck       },
    {"head",     kHead       },
    {"endsite",  kEndSite    },
    {"clavicle", kClavicle   },
    {"clav",     kClavicle   },
    {"collar",   kClavicle   },
    {"shoulder", kShoulder   },
    {"shldr",    kShoulder   },
    {"arm",      kArm        },
    {"uarm",     kUp | kArm  },
    {"humerus",  kUp | kArm  },
    {"farm",     kFore | kArm},
    {"elbow",    kFore | kArm},
    {"radius",   kFore | kArm},
    {"wrist",    kWrist      },
    {"hand",     kHand       },
    {"leg",      kLeg        },
    {"thigh",    kUp | kLeg  },
    {"femur",    kUp | kLeg  },
    {"knee",     kLow | kLeg },
    {"shin",     kLow | kLeg },
    {"calf",     kLow | kLeg },
    {"tibia",    kLow | kLeg },
    {"ankle",    kAnkle      },
    {"foot",     kFoot       },
    {"toe",      kToe        },
    {"toes",     kToe        },
    {"ball",     kToe        },
    {"bale",     kToe        }, // the ball, misspelled in a widespread rig
};

// Sorted, because looking up words is the inner loop of every search by names.
constexpr auto kSortedLexicon = [] {
    auto words = std::to_array(kLexicon);
    std::ranges::sort(words, {}, &Word::text);
    return words;
}();

constexpr size_t kLetterCount = 'z' - 'a' + 1;

// The index of the first word that starts with a letter or a later one.
constexpr auto kFirstWord = [] {
    std::array<uint8_t, kLetterCount + 1> first{};
    for (size_t letter = 0; letter <= kLetterCount; ++letter)
        first[letter] = static_cast<uint8_t>(std::ranges::count_if(
            kLexicon, [=](const Word& word) { return word.text.front() < static_cast<char>('a' + letter); }));
    return first;
}();

std::span<const Word> WordsFrom(char letter)
{
    if (letter < 'a' || letter > 'z')
        return {};
    const auto index = static_cast<size_t>(letter - 'a');
    return std::span(kSortedLexicon).subspan(kFirstWord[index], kFirstWord[index + 1] - kFirstWord[index]);
}

constexpr uint32_t kSides = kLeft | kRight;
constexpr uint32_t kLevels = kUp | kLow | kMid;

// A name matches a joint if it has all required features and no forbidden one.
struct Meaning
{
    uint32_t needed;
    uint32_t allowed; // in addition to those needed
    EJointWord word;
};

constexpr Meaning kMiddleMeanings[] = {
    {kHip,                kPelvis | kCenter | kBase,              EJointWord::Hip    },
    {kPelvis,             kCenter | kBase,                        EJointWord::Hip    },
    {kSpine | kBase,      kNothing,                               EJointWord::HipBase},
    {kTorso | kLow,       kNothing,                               EJointWord::HipBase},
    {kSpine,              kLevels | kTorso | kShoulder | kCenter, EJointWord::Spine  },
    {kTorso,              kLevels | kCenter,                      EJointWord::Spine  },
    {kShoulder | kCenter, kNothing,                               EJointWord::Spine  },
    {kNeck,               kLevels | kBase,                        EJointWord::Neck   },
    {kHead,               kNothing,                               EJointWord::Head   },
    {kHead | kEndSite,    kNothing,                               EJointWord::HeadEnd},
};

constexpr Meaning kSideMeanings[] = {
    {kClavicle,     kNothing, EJointWord::Clavicle},
    {kShoulder,     kNothing, EJointWord::Shoulder},
    {kUp | kArm,    kNothing, EJointWord::UpperArm},
    {kArm,          kNothing, EJointWord::Arm     },
    {kFore | kArm,  kNothing, EJointWord::Forearm },
    {kLow | kArm,   kNothing, EJointWord::Forearm },
    {kWrist,        kNothing, EJointWord::Wrist   },
    {kHand,         kNothing, EJointWord::Hand    },
    {kHip,          kNothing, EJointWord::SideHip },
    {kUp | kLeg,    kNothing, EJointWord::Thigh   },
    {kLeg,          kNothing, EJointWord::Leg     },
    {kLow | kLeg,   kNothing, EJointWord::Shin    },
    {kAnkle,        kNothing, EJointWord::Ankle   },
    {kFoot,         kNothing, EJointWord::Foot    },
    {kToe,          kBase,    EJointWord::Toe     },
    {kFore | kFoot, kNothing, EJointWord::Toe     },
};

constexpr size_t kLongestToken = 48; // longer than any joint name without separators

// Returns the features of a run of letters that consists only of lexicon words, using as few as possible, so
// that "upperarm" is not "up", "per" and "arm". Nothing if it contains anything else.
std::optional<uint32_t> Features(std::string_view token)
{
    if (token.size() > kLongestToken)
        return {};
    struct Part
    {
        size_t words; // SIZE_MAX if none are known
        uint32_t features;
    };
    std::array<Part, kLongestToken + 1> parts; // of the first n letters
    parts[0] = {0, kNothing};
    std::fill_n(&parts[1], token.size(), Part{SIZE_MAX, kNothing});
    for (size_t begin = 0; begin < token.size(); ++begin)
    {
        const Part& part = parts[begin];
        if (part.words == SIZE_MAX)
            continue;
        for (const Word& word : WordsFrom(token[begin]))
        {
            const size_t end = begin + word.text.size();
            // Few words have the right last letter, too.
            if (end > token.size() || token[end - 1] != word.text.back() ||
                !token.substr(begin).starts_with(word.text))
                continue;
            Part& longer = parts[end];
            if (part.words + 1 < longer.words)
                longer = {part.words + 1, part.features | word.features};
        }
    }
    const Part& whole = parts[token.size()];
    return whole.words < SIZE_MAX ? std::optional(whole.features) : std::nullopt;
}

// The same with a side that a letter stands for. Nothing for any other letter.
std::optional<uint32_t> SideFeatures(char letter, std::string_view token)
{
    const uint32_t side = letter == 'l' ? kLeft : letter == 'r' ? kRight : kNothing;
    const std::optional<uint32_t> features = side ? Features(token) : std::nullopt;
    return features ? std::optional(*features | side) : std::nullopt;
}

// Same for a token that can include a letter for the side, or consist of it.
std::optional<uint32_t> TokenFeatures(std::string_view token)
{
    if (token == "c")
        return kNothing; // the letter for the middle, besides L and R
    if (const auto whole = Features(token))
        return whole;
    if (const auto front = SideFeatures(token.front(), token.substr(1)))
        return front;
    return SideFeatures(token.back(), token.substr(0, token.size() - 1));
}

bool IsDigit(char c)
{
    return c >= '0' && c <= '9';
}

bool IsLetter(char c)
{
    return (c >= 'a' && c <= 'z') || (c & 0x80) != 0; // non-ASCII letters belong to unknown words
}

template <class Is>
std::string_view TakeWhile(std::string_view& rest, Is is)
{
    size_t length = 0;
    while (length < rest.size() && is(rest[length]))
        ++length;
    const std::string_view taken = rest.substr(0, length);
    rest.remove_prefix(length);
    return taken;
}

// Returns the features of a name's words. Nothing if a word is unknown or two numbers mark it as one of many.
std::optional<uint32_t> NameFeatures(std::string_view rest, int& number)
{
    uint32_t features = kNothing;
    while (!rest.empty())
    {
        if (const std::string_view digits = TakeWhile(rest, IsDigit); !digits.empty())
        {
            if (number >= 0)
                return {};
            number = ParseInt(digits);
        }
        else if (const std::string_view letters = TakeWhile(rest, IsLetter); !letters.empty())
        {
            const std::optional<uint32_t> more = TokenFeatures(letters);
            if (!more)
                return {};
            features |= *more;
        }
        else
            rest.remove_prefix(1);
    }
    return features;
}

template <size_t count>
EJointWord WordOf(uint32_t features, const Meaning (&meanings)[count])
{
    for (const Meaning& meaning : meanings)
    {
        if ((features & meaning.needed) == meaning.needed &&
            (features & ~(meaning.needed | meaning.allowed)) == 0)
            return meaning.word;
    }
    return EJointWord::None;
}

// "L5", "T12", "C7": vertebrae of the lumbar spine, the thorax and the neck.
EJointWord VertebraOf(std::string_view name)
{
    constexpr size_t kMostDigits = 2;
    std::string_view digits = name.substr(std::min<size_t>(name.size(), 1));
    if (digits.empty() || digits.size() > kMostDigits || TakeWhile(digits, IsDigit).empty() ||
        !digits.empty())
        return EJointWord::None;
    if (name.front() == 'c')
        return EJointWord::Neck;
    return name.front() == 'l' || name.front() == 't' ? EJointWord::Spine : EJointWord::None;
}

} // namespace

JointName ReadJointName(std::string_view name)
{
    const std::string lower = LowerCase(name);
    JointName joint;
    joint.word = VertebraOf(lower);
    if (joint.word != EJointWord::None)
        return joint;
    const std::optional<uint32_t> features = NameFeatures(lower, joint.number);
    if (!features || (*features & kSides) == kSides)
        return {};
    const uint32_t side = *features & kSides;
    const uint32_t words = *features & ~(kSides | kJoint);
    joint.word = side ? WordOf(words, kSideMeanings) : WordOf(words, kMiddleMeanings);
    joint.side = side == kLeft ? ENameSide::Left : side == kRight ? ENameSide::Right : ENameSide::None;
    joint.helper = (*features & kJoint) || lower.starts_with('_');
    return joint;
}

} // namespace gw
