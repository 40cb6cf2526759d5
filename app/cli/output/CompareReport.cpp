#include "CompareReport.h"

#include "CJsonWriter.h"
#include "ConversionMeasures.h"
#include "Text.h"

#include <cstdio>
#include <variant>

namespace gw {

namespace {

// The type of a record's figure.
template <class Record>
using Figure = std::variant<double Record::*, std::optional<double> Record::*, size_t Record::*,
                            int Record::*, bool Record::*, std::string Record::*>;

template <class Record>
struct FigureRow
{
    const char* name;
    Figure<Record> member;
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
    {"sourceJitter", &BoneMeasures::sourceJitter},
    {"resultJitter", &BoneMeasures::resultJitter},
};

constexpr FigureRow<FootMeasures> kFootFigures[] = {
    {"target",                  &FootMeasures::target                 },
    {"source",                  &FootMeasures::source                 },
    {"turnMean",                &FootMeasures::turnMean               },
    {"turnError",               &FootMeasures::turnError              },
    {"turnLargest",             &FootMeasures::turnLargest            },
    {"turnWhileStanding",       &FootMeasures::turnWhileStanding      },
    {"turnFromStart",           &FootMeasures::turnFromStart          },
    {"soleTiltMean",            &FootMeasures::soleTiltMean           },
    {"soleTiltLargest",         &FootMeasures::soleTiltLargest        },
    {"sourceSoleTiltMean",      &FootMeasures::sourceSoleTiltMean     },
    {"addedSlideMean",          &FootMeasures::addedSlideMean         },
    {"addedSlideLargest",       &FootMeasures::addedSlideLargest      },
    {"addedSlideMeanShare",     &FootMeasures::addedSlideMeanShare    },
    {"addedSlideLargestShare",  &FootMeasures::addedSlideLargestShare },
    {"sourceSlideShare",        &FootMeasures::sourceSlideShare       },
    {"resultSlideShare",        &FootMeasures::resultSlideShare       },
    {"sourceContacts",          &FootMeasures::sourceContacts         },
    {"resultContacts",          &FootMeasures::resultContacts         },
    {"sourceStanding",          &FootMeasures::sourceStanding         },
    {"resultStanding",          &FootMeasures::resultStanding         },
    {"bothStanding",            &FootMeasures::bothStanding           },
    {"contactF1",               &FootMeasures::contactF1              },
    {"kneePops",                &FootMeasures::kneePops               },
    {"kneePopLargest",          &FootMeasures::kneePopLargest         },
    {"kneeChangeLargest",       &FootMeasures::kneeChangeLargest      },
    {"sourceKneeChangeLargest", &FootMeasures::sourceKneeChangeLargest},
};

constexpr FigureRow<ConversionMeasures> kFigures[] = {
    {"frameCount",   &ConversionMeasures::frameCount  },
    {"frameScale",   &ConversionMeasures::frameScale  },
    {"sourceLeg",    &ConversionMeasures::sourceLeg   },
    {"resultLeg",    &ConversionMeasures::resultLeg   },
    {"meanError",    &ConversionMeasures::meanError   },
    {"largestError", &ConversionMeasures::largestError},
    {"sourceJitter", &ConversionMeasures::sourceJitter},
    {"resultJitter", &ConversionMeasures::resultJitter},
    {"jitterRatio",  &ConversionMeasures::jitterRatio },
    {"contactF1",    &ConversionMeasures::contactF1   },
    {"floorHeight",  &ConversionMeasures::floorHeight },
    {"sinkDepth",    &ConversionMeasures::sinkDepth   },
    {"sourceTravel", &ConversionMeasures::sourceTravel},
    {"resultTravel", &ConversionMeasures::resultTravel},
    {"travelRatio",  &ConversionMeasures::travelRatio },
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

template <class Record, size_t count>
void WriteFigures(CJsonWriter& json, const Record& record, const FigureRow<Record> (&rows)[count])
{
    for (const FigureRow<Record>& row : rows)
    {
        json.Key(row.name);
        std::visit([&](auto member) { Write(json, record.*member); }, row.member);
    }
}

template <class Record, size_t count>
void WriteList(CJsonWriter& json, const char* name, const std::vector<Record>& records,
               const FigureRow<Record> (&rows)[count], ERecordLayout layout)
{
    json.Key(name).BeginArray();
    for (const Record& record : records)
    {
        if (layout == ERecordLayout::Lines)
            json.BreakLine();
        json.BeginObject();
        WriteFigures(json, record, rows);
        json.EndObject();
    }
    json.EndArray();
}

std::string Optional(const std::optional<double>& value)
{
    char text[32];
    std::snprintf(text, sizeof text, "%.3f", value.value_or(0.0));
    return value ? text : "none";
}

void PrintBones(const ConversionMeasures& measures)
{
    std::printf("%-14s %-20s %10s %10s %8s %12s %12s\n", "bone", "source", "mean deg", "max deg", "at frame",
                "jitter", "of source");
    for (const BoneMeasures& bone : measures.bones)
    {
        if (!bone.measured)
            continue;
        std::printf("%-14s %-20s %10.3f %10.3f %8d %12.6f %12.6f\n", Printable(bone.target).c_str(),
                    Printable(bone.source).c_str(), bone.meanError, bone.largestError, bone.largestFrame,
                    bone.resultJitter, bone.sourceJitter);
    }
}

void PrintFeet(const ConversionMeasures& measures, const char* indent)
{
    for (const FootMeasures& foot : measures.feet)
    {
        std::printf(
            "%s%s: contacts %zu of %zu, F1 %s; added slide %.2f mm mean, %.2f mm max; turn %.2f deg mean; "
            "sole %.2f deg mean; knee pops %zu\n",
            indent, Printable(foot.target).c_str(), foot.resultContacts, foot.sourceContacts,
            Optional(foot.contactF1).c_str(), foot.addedSlideMean, foot.addedSlideLargest, foot.turnError,
            foot.soleTiltMean, foot.kneePops);
    }
}

} // namespace

void PrintSums(const ConversionMeasures& measures, const char* indent)
{
    std::printf("%sdirections: %.3f deg mean, %.3f deg max, over %d frames\n", indent, measures.meanError,
                measures.largestError, measures.frameCount);
    PrintFeet(measures, indent);
    std::printf("%scontacts F1 %s; floor %s mm; sinks %.2f mm; travel ratio %s; jitter ratio %s\n", indent,
                Optional(measures.contactF1).c_str(), Optional(measures.floorHeight).c_str(),
                measures.sinkDepth, Optional(measures.travelRatio).c_str(),
                Optional(measures.jitterRatio).c_str());
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
    WriteMeasures(json, measures, ERecordLayout::Lines);
    json.EndObject();
    json.EndDocument();
}

void WriteMeasures(CJsonWriter& json, const ConversionMeasures& measures, ERecordLayout layout)
{
    WriteFigures(json, measures, kFigures);
    WriteList(json, "bones", measures.bones, kBoneFigures, layout);
    WriteList(json, "feet", measures.feet, kFootFigures, layout);
}

} // namespace gw
