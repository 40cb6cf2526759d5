#include "CompareText.h"

#include "CJsonWriter.h"
#include "ConversionMeasures.h"
#include "JsonStatus.h"
#include "Text.h"

#include <cstdio>
#include <variant>

namespace gw {

namespace {

// A pointer to a record's member, by the type of its value.
template <class Record>
using Figure = std::variant<double Record::*, std::optional<double> Record::*, size_t Record::*,
                            int Record::*, bool Record::*, std::string Record::*, SlideMeasures Record::*>;

template <class Record>
struct FigureRow
{
    const char* name;
    Figure<Record> member;
};

constexpr FigureRow<SlideMeasures> kSlideFigures[] = {
    {"plants",       &SlideMeasures::plants      },
    {"median",       &SlideMeasures::median      },
    {"largest",      &SlideMeasures::largest     },
    {"largestFrame", &SlideMeasures::largestFrame},
};

constexpr FigureRow<BoneMeasures> kBoneFigures[] = {
    {"target",       &BoneMeasures::target      },
    {"source",       &BoneMeasures::source      },
    {"targetChild",  &BoneMeasures::targetChild },
    {"sourceChild",  &BoneMeasures::sourceChild },
    {"measured",     &BoneMeasures::measured    },
    {"meanError",    &BoneMeasures::meanError   },
    {"largestError", &BoneMeasures::largestError},
    {"largestFrame", &BoneMeasures::largestFrame},
};

constexpr FigureRow<FootMeasures> kFootFigures[] = {
    {"target",             &FootMeasures::target            },
    {"source",             &FootMeasures::source            },
    {"turnMean",           &FootMeasures::turnMean          },
    {"turnError",          &FootMeasures::turnError         },
    {"turnLargest",        &FootMeasures::turnLargest       },
    {"turnWhileStanding",  &FootMeasures::turnWhileStanding },
    {"turnFromStart",      &FootMeasures::turnFromStart     },
    {"soleTiltMean",       &FootMeasures::soleTiltMean      },
    {"soleTiltLargest",    &FootMeasures::soleTiltLargest   },
    {"sourceSoleTiltMean", &FootMeasures::sourceSoleTiltMean},
    {"ankleSlide",         &FootMeasures::ankleSlide        },
    {"toeSlide",           &FootMeasures::toeSlide          },
    {"sourceContacts",     &FootMeasures::sourceContacts    },
    {"resultContacts",     &FootMeasures::resultContacts    },
    {"sourceStanding",     &FootMeasures::sourceStanding    },
    {"resultStanding",     &FootMeasures::resultStanding    },
    {"bothStanding",       &FootMeasures::bothStanding      },
    {"contactF1",          &FootMeasures::contactF1         },
    {"kneePops",           &FootMeasures::kneePops          },
    {"kneePopLargest",     &FootMeasures::kneePopLargest    },
    {"heldSole",           &FootMeasures::heldSole          },
    {"heldSoleLargest",    &FootMeasures::heldSoleLargest   },
    {"heldSoleFrame",      &FootMeasures::heldSoleFrame     },
};

constexpr FigureRow<HandMeasures> kHandFigures[] = {
    {"target",      &HandMeasures::target     },
    {"source",      &HandMeasures::source     },
    {"touchFrames", &HandMeasures::touchFrames},
    {"gap",         &HandMeasures::gap        },
    {"gapPart",     &HandMeasures::gapPart    },
    {"gapLargest",  &HandMeasures::gapLargest },
    {"gapFrame",    &HandMeasures::gapFrame   },
    {"depth",       &HandMeasures::depth      },
    {"depthFrame",  &HandMeasures::depthFrame },
};

constexpr FigureRow<ConversionMeasures> kFigures[] = {
    {"frameCount",         &ConversionMeasures::frameCount        },
    {"frameScale",         &ConversionMeasures::frameScale        },
    {"sourceLeg",          &ConversionMeasures::sourceLeg         },
    {"resultLeg",          &ConversionMeasures::resultLeg         },
    {"meanError",          &ConversionMeasures::meanError         },
    {"largestError",       &ConversionMeasures::largestError      },
    {"trunkMean",          &ConversionMeasures::trunkMean         },
    {"trunkMost",          &ConversionMeasures::trunkMost         },
    {"trunkLargest",       &ConversionMeasures::trunkLargest      },
    {"trunkFrame",         &ConversionMeasures::trunkFrame        },
    {"jitterRatio",        &ConversionMeasures::jitterRatio       },
    {"jitterRatioLargest", &ConversionMeasures::jitterRatioLargest},
    {"ankleSlide",         &ConversionMeasures::ankleSlide        },
    {"toeSlide",           &ConversionMeasures::toeSlide          },
    {"contactF1",          &ConversionMeasures::contactF1         },
    {"heldSole",           &ConversionMeasures::heldSole          },
    {"sinkDepth",          &ConversionMeasures::sinkDepth         },
    {"handGap",            &ConversionMeasures::handGap           },
    {"handDepth",          &ConversionMeasures::handDepth         },
    {"sourceTravel",       &ConversionMeasures::sourceTravel      },
    {"resultTravel",       &ConversionMeasures::resultTravel      },
    {"travelRatio",        &ConversionMeasures::travelRatio       },
};

void Write(CJsonWriter& json, double value)
{
    json.Number(static_cast<float>(value));
}
void Write(CJsonWriter& json, int value)
{
    json.Integer(value);
}
void Write(CJsonWriter& json, size_t value)
{
    json.Integer(static_cast<int64_t>(value));
}
void Write(CJsonWriter& json, bool value)
{
    json.Bool(value);
}
void Write(CJsonWriter& json, const std::string& value)
{
    json.Text(value);
}
void Write(CJsonWriter& json, const std::optional<double>& value)
{
    if (value)
        Write(json, *value);
    else
        json.Null();
}

void Write(CJsonWriter& json, const SlideMeasures& slide);

template <class Record, size_t count>
void WriteFigures(CJsonWriter& json, const Record& record, const FigureRow<Record> (&rows)[count])
{
    for (const FigureRow<Record>& row : rows)
    {
        json.Key(row.name);
        std::visit([&](auto member) { Write(json, record.*member); }, row.member);
    }
}

void Write(CJsonWriter& json, const SlideMeasures& slide)
{
    json.BeginObject();
    WriteFigures(json, slide, kSlideFigures);
    json.EndObject();
}

template <class Record, size_t count>
void WriteList(CJsonWriter& json, const char* name, const std::vector<Record>& records,
               const FigureRow<Record> (&rows)[count])
{
    json.Key(name).BeginArray();
    for (const Record& record : records)
    {
        json.BeginObject();
        WriteFigures(json, record, rows);
        json.EndObject();
    }
    json.EndArray();
}

// Returns the figure with its unit, or "none".
std::string Optional(const std::optional<double>& value, int decimals = 3, const char* unit = "")
{
    char text[48];
    std::snprintf(text, sizeof text, "%.*f%s", decimals, value.value_or(0.0), unit);
    return value ? text : "none";
}

std::string Slide(const SlideMeasures& slide)
{
    char text[96];
    std::snprintf(text, sizeof text, "%.2f mm median, %.2f mm worst of %zu", slide.median, slide.largest,
                  slide.plants);
    return slide.plants > 0 ? text : "none";
}

void PrintBones(const ConversionMeasures& measures)
{
    std::printf("%-14s %-20s %10s %10s %8s\n", "bone", "source", "mean deg", "max deg", "at frame");
    for (const BoneMeasures& bone : measures.bones)
    {
        if (!bone.measured)
            continue;
        std::printf("%-14s %-20s %10.3f %10.3f %8d\n", Printable(bone.target).c_str(),
                    Printable(bone.source).c_str(), bone.meanError, bone.largestError, bone.largestFrame);
    }
}

void PrintFeet(const ConversionMeasures& measures, const char* indent)
{
    for (const FootMeasures& foot : measures.feet)
    {
        std::printf(
            "%s%s: added slide of the ankle %s, of the toe %s; contacts %zu of %zu, F1 %s; turn %.2f deg "
            "mean; sole %.2f deg mean; knee pops %zu\n",
            indent, Printable(foot.target).c_str(), Slide(foot.ankleSlide).c_str(),
            Slide(foot.toeSlide).c_str(), foot.resultContacts, foot.sourceContacts,
            Optional(foot.contactF1).c_str(), foot.turnError, foot.soleTiltMean, foot.kneePops);
    }
}

void PrintHands(const ConversionMeasures& measures, const char* indent)
{
    for (const HandMeasures& hand : measures.hands)
    {
        const std::string part = hand.gap ? " (" + hand.gapPart + ")" : "";
        std::printf("%s%s: touches in %zu frames; gap %s%s; %.2f mm below the floor\n", indent,
                    Printable(hand.target).c_str(), hand.touchFrames, Optional(hand.gap, 2, " mm").c_str(),
                    part.c_str(), hand.depth);
    }
}

} // namespace

void PrintSums(const ConversionMeasures& measures, const char* indent)
{
    std::printf("%sdirections: %.3f deg mean, %.3f deg max, over %d frames\n", indent, measures.meanError,
                measures.largestError, measures.frameCount);
    std::printf("%strunk: %s mean, %s at 95 %%\n", indent, Optional(measures.trunkMean, 3, " deg").c_str(),
                Optional(measures.trunkMost, 3, " deg").c_str());
    PrintFeet(measures, indent);
    PrintHands(measures, indent);
    std::printf(
        "%scontacts F1 %s; held soles off the floor by %s; sinks %.2f mm; hip path ratio %s; leg jitter "
        "ratio %s median, %s worst\n",
        indent, Optional(measures.contactF1).c_str(), Optional(measures.heldSole, 2, " mm").c_str(),
        measures.sinkDepth, Optional(measures.travelRatio).c_str(), Optional(measures.jitterRatio).c_str(),
        Optional(measures.jitterRatioLargest).c_str());
}

void PrintMeasures(const ConversionMeasures& measures)
{
    PrintBones(measures);
    PrintSums(measures, "");
}

void WriteMeasures(const ConversionMeasures& measures)
{
    CJsonWriter json(stdout);
    json.BeginObject();
    WriteStatus(json, "ok");
    WriteMeasures(json, measures);
    json.EndObject();
    json.EndDocument();
}

void WriteMeasures(CJsonWriter& json, const ConversionMeasures& measures)
{
    WriteFigures(json, measures, kFigures);
    WriteList(json, "bones", measures.bones, kBoneFigures);
    WriteList(json, "feet", measures.feet, kFootFigures);
    WriteList(json, "hands", measures.hands, kHandFigures);
}

} // namespace gw
