#pragma once
// The project document as the strongest check of an animation or keyframe
// edit: undo gives back the text before, redo the text after, and a refused
// edit leaves it and the history as they were.

#include "EditTestSupport.h"

#include <VelaMediaLib/document/ProjectDocument.h>

namespace VelaMediaLib {
namespace testing {

class DocumentEditTest : public EditTest {
protected:
    std::string document() const { return projectToJSONString(*project); }

    void expectExactDocumentUndo(const CommandPtr& command) {
        const std::string before = document();
        ASSERT_TRUE(project->execute(command)) << command->name();
        const std::string after = document();
        EXPECT_NE(after, before) << command->name();
        ASSERT_TRUE(project->undo()) << command->name();
        EXPECT_EQ(document(), before) << command->name();
        ASSERT_TRUE(project->redo()) << command->name();
        EXPECT_EQ(document(), after) << command->name();
    }
    void expectRefusedDocument(const CommandPtr& command) {
        const std::string before = document();
        const size_t stepsBefore = steps();
        EXPECT_FALSE(project->execute(command)) << command->name();
        EXPECT_EQ(document(), before) << command->name();
        EXPECT_EQ(steps(), stepsBefore) << command->name();
    }
};

} // namespace testing
} // namespace VelaMediaLib
