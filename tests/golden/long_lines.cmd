SET NETLIST NAME long_lines
ADD PORT D(16:0) Input
ADD PORT a_port_whose_name_is_so_long_that_its_declaration_cannot_fit(15:0) Output
ADD PORT W(0:15) Output
CONNECT SIGNAL a_port_whose_name_is_so_long_that_its_declaration_cannot_fit(15:0) D(15:0)
CONNECT SIGNAL W(0:15) D(0:15)
