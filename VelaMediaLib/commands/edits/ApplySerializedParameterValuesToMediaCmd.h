#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/edits/detail/AnimationEdits.h>

namespace VelaMediaLib {

/// Applies serialized parameter values to a clip: the text of a "parameters"
/// object as the project document writes it (a clip's parameters copied to
/// paste their look onto another). Each parameter named takes the curve
/// written for it whole (keyframes, bounds, hints), as a document read would
/// give it; parameters not named keep theirs. Parameters the clip had not
/// made are made, and forgotten again on undo. create throws for text that is
/// not a JSON object and for a name the clip has no parameter of; execute
/// throws what the reader throws for a value the parameter cannot read (of
/// the wrong type), changing nothing, and is refused (false) when every
/// parameter already held what was written.
class VELAMEDIALIB_API ApplySerializedParameterValuesToMediaCmd : public ParameterCurvesEditCmd {
public:
    static boost::shared_ptr<ApplySerializedParameterValuesToMediaCmd> create(const MediaPtr& media,
                                                                              const std::string& serialized);

private:
    ApplySerializedParameterValuesToMediaCmd(const MediaPtr& media, const std::string& serialized)
        : media_(media), serialized_(serialized) {}
    bool edit() override;

    MediaPtr media_;
    std::string serialized_;
};

} // namespace VelaMediaLib
