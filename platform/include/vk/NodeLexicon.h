#pragma once

namespace VK {

/// The numbers by which nodes, properties and path types are known. Only the numbers cross the interface: every value
/// of the underlying type may be passed, named here or not.
class NodeLexicon {
public:
    enum NodeType : unsigned int {
        SystemChassisNode = 1,  ///< a chassis
        ComputerSystemNode = 40 ///< the host computer system
    };

    enum Properties : unsigned int {
        ManufacturerProperty = 36,           ///< text
        ModelProperty = 39,                  ///< text
        SerialNumberProperty = 50,           ///< text
        UUIDProperty = 64,                   ///< text, lower case with dashes
        SKUProperty = 86,                    ///< text
        NameProperty = 108,                  ///< text; a computer system's host name
        PrimaryOwnerContactProperty = 115,   ///< text
        PrimaryOwnerNameProperty = 116,      ///< text
        PowerStateProperty = 123,            ///< number: 0 unknown, 1 on, 16 shutting down
        SystemTimeProperty = 126,            ///< text, a CIM date-time
        GmtOffsetProperty = 127,             ///< number: minutes east of UTC, two's complement
        PackageTypeProperty = 128,           ///< number: 0 unknown, 1 chassis, 2 rack, 3 blade, 4 and above other
        AutomaticDSTAdjustmentProperty = 200 ///< number: 0 or 1
    };

    enum PathType : unsigned int {
        NamePath = 0 ///< one exact node path
    };
};

} // namespace VK
