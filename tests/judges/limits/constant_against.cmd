SET NETLIST NAME constant_against
ADD NOTES "A hexadecimal constant on a slice that runs against its bus."
ADD PORT A Input
ADD PORT Y(7:0) Output
ADD PORT Z Output
CONNECT SIGNAL Z A
ASSIGN CONSTANT Y(4:7) 4:H:A
ASSIGN CONSTANT Y(3:0) 4:H:5
