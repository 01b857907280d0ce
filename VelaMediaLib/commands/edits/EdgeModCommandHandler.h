#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/model/media/Media.h>

namespace VelaMediaLib {

class CommandHandler;

/// What the edge-modification commands reach a clip's edge modifications
/// through, as CommandHandler is for timing edits: a host that wants to see
/// or steer these changes gives the commands a handler of its own. Each
/// operation is one elementary change of one edge of one clip and answers
/// false when it refuses (changing nothing). The commands check their own
/// rules (lengths within the clip, the modification present or not) before
/// they call; undo calls the same operations with the values from before, so
/// a handler must not add rules of length there (a clip trimmed after its fade
/// was added still takes the fade back).
///
/// This class is also the default: it edits the clips directly, checking and
/// changing an edge in one step under the project's write lock and notifying
/// the clip once that lock has ended. It keeps nothing, so one instance
/// serves every project (defaultHandler).
class VELAMEDIALIB_API EdgeModCommandHandler {
public:
    enum Edge { Left, Right };

    virtual ~EdgeModCommandHandler() = default;

    /// Puts the modification on the clip's edge before the entry at index
    /// (the edge's count appends). Refuses a null clip or modification, one
    /// already on either edge of the clip, and an index past the end.
    virtual bool insertEdgeModification(const MediaPtr& media, Edge edge, size_t index,
                                        const EdgeModificationPtr& modification);
    /// Takes the modification off the clip's edge; refuses one not there.
    virtual bool removeEdgeModification(const MediaPtr& media, Edge edge,
                                        const EdgeModificationPtr& modification);
    /// Gives a modification on the clip's edge the duration; refuses one not
    /// there and a negative duration.
    virtual bool setEdgeModificationDuration(const MediaPtr& media, Edge edge,
                                             const EdgeModificationPtr& modification, VelaTime duration);

    /// The shared default instance.
    static EdgeModCommandHandler& defaultHandler();
    /// The handler a command finds when it was given none: that of the
    /// handler's project, else the default.
    static EdgeModCommandHandler& forCommandHandler(CommandHandler* handler);

    /// The modifications on the clip's edge, in order (under the read lock).
    static EdgeModifiable::EdgeModifications edgeModifications(const Media& media, Edge edge);
    /// "left" or "right", for messages.
    static const char* edgeName(Edge edge) { return edge == Left ? "left" : "right"; }
};

typedef boost::shared_ptr<EdgeModCommandHandler> EdgeModCommandHandlerPtr;

} // namespace VelaMediaLib
