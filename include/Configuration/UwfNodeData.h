// UwfNodeData: one node of a user's folder tree in the user-workflow service: a folder or an item
// (an exam reference), with its owner, parent, sharing flag and the caller's opaque data. The
// service sets the modification time and the counts of sub-folders and sub-items; they are read,
// never written. Made only by Create() and shared through SmartPtr; a plain record without
// locks: fill and read one record on one thread at a time.
#pragma once

#include <ace/SString.h>

#include "Configuration/Export.h"
#include "Configuration/SmartPtr.h"
#include "Quorvex/BDateTime.h"

namespace Vesk {
class XmlEmitter;
}

namespace Configuration {

class CONFIGURATION_API UwfNodeData {
public:
    // The kinds of node; the wire carries them as "0" and "1".
    enum NodeType { Folder = 0, Item = 1 };

    // A new record with every field at its default (empty, 0, false, invalid time).
    static SmartPtr<UwfNodeData> Create();
    UwfNodeData(const UwfNodeData& other) = default;
    UwfNodeData& operator=(const UwfNodeData& other) = default;

    // Writes <Node> with the written fields in order, leaving out empty ones.
    void WriteXml(Vesk::XmlEmitter& xml) const;
    // Reads the fields from the elements of text; a missing element keeps its field. Name and
    // UserId arrive as UTF-8 and are converted to the local code page; throws std::exception
    // when "Shared" is no flag.
    void LoadXml(const ACE_CString& text);

    // "NodeDataSet".
    static const char* DataSetName();
    // The namespace URI of the record, ending in "/UserWorkFlow/Node".
    static const char* Namespace();

    ACE_CString Id;
    ACE_CString Name;
    ACE_CString UserId;
    ACE_CString ParentId;
    NodeType Type = Folder;
    bool Shared = false;
    BDateTime ModifiedDateTime;  // read only
    int SubFolders = 0;          // read only
    int SubItems = 0;            // read only
    ACE_CString OpaqueData;

private:
    UwfNodeData() = default;
};

}  // namespace Configuration
