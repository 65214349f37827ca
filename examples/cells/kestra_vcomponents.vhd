-- Stands in for the vendor's package that every VHDL netlist names by default;
-- analyse it into the library KESTRA. The netlists declare their own components.

package Vcomponents is
end Vcomponents;
