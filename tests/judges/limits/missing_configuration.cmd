SET NETLIST NAME missing_configuration
ADD NOTES "A leaf cell that has no configuration, in a netlist that has one."

ADD COMPONENT INV1
ADD PIN INV1 I(0:0) Input
ADD PIN INV1 O(0:0) Output

ADD PORT A Input
ADD PORT Y Output
ADD INSTANCE INV1 U1
CONNECT SIGNAL A U1.I(0:0)
CONNECT SIGNAL Y U1.O(0:0)
