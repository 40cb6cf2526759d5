#include "StringTable.h"

#include <algorithm>

namespace gw {

namespace {

struct Entry
{
    int m_iID;
    std::string_view m_kText;
};

constexpr Entry kStrings[] = {
    {101, "About GaitTool(&A)..."                                                },
    {128, "Gaitwright v2.0"                                                      },
    {129, "Arial"                                                                },
    {130, "100"                                                                  },
    {131, "Software\\Tessarine\\Kestro\\2.0"                                     },
    {132, "Software\\Tessarine\\Gaitwright 2\\2.0"                               },
    {133, "Custom Motion Folder"                                                 },
    {135, "Main Program"                                                         },
    {136, "Unable to locate Kestro's motion folder."                             },
    {137, "Unable to locate Kestro."                                             },
    {138, "Invalid BVH file format."                                             },
    {139, "Save convertion result?"                                              },
    {143, "https://tessarine.example/gaitwright?lang=%s"                         },
    {144, "Unable to convert motion with selected profile!"                      },
    {146, "%d BVH files are successful convert to HTR."                          },
    {147, "Batch Converting %d : %s"                                             },
    {148, "%d HTR files are successful convert to ORN."                          },
    {149, "source"                                                               },
    {150, "Target"                                                               },
    {151, "RX"                                                                   },
    {152, "RY"                                                                   },
    {153, "RZ"                                                                   },
    {154, "SOFTWARE\\Tessarine\\Kestro\\2.0"                                     },
    {155, "This profile name is already exist. Please use another name."         },
    {156, "Profile name cannot be blank."                                        },
    {157, "The avaliable value is %d to %d."                                     },
    {158, "This profile name is invalid. Please use another name."               },
    {159, "Profile saved successfully."                                          },
    {160, "Failed in savinf profile."                                            },
    {161, "Do you want to save the profile changes?"                             },
    {163, "Are you sure to overwrite this profile?"                              },
    {164, "BVH Animation Files (*.bvh) |*.bvh|ORN Animation File (*.orn)|*.orn||"},
    {165, "Kestro Motion File (*.Kinetra) |*.Kinetra||"                          },
    {166, "Are you sure to remove this profile?"                                 },
    {167, "::/Using_Gaitwright.htm"                                              },
    {168, "X"                                                                    },
    {169, "Y"                                                                    },
    {170, "Z"                                                                    },
    {171, "Show the file in its folder?"                                         },
};

} // namespace

std::string_view BuiltInString(int id)
{
    const auto* found = std::ranges::lower_bound(kStrings, id, {}, &Entry::m_iID);
    return found != std::end(kStrings) && found->m_iID == id ? found->m_kText : std::string_view();
}

bool EndsStep(int id)
{
    constexpr int kEnds[] = {kInvalidSourceMessage, kCannotConvertMessage, kConvertedMessage,
                             kPackagedMessage,      kShowFileMessage,      kOwnMessage};
    return std::ranges::find(kEnds, id) != std::end(kEnds);
}

std::string FormatText(std::string_view format, std::span<const std::string> arguments)
{
    std::string text;
    size_t used = 0;
    for (size_t i = 0; i < format.size(); ++i)
    {
        const char kind = format[i] == '%' && i + 1 < format.size() ? format[i + 1] : '\0';
        if (kind != 'd' && kind != 's')
        {
            text += format[i];
            continue;
        }
        if (used < arguments.size())
            text += arguments[used++];
        ++i;
    }
    return text;
}

} // namespace gw
