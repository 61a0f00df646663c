"""A reader of MOF class declarations, with every check that a MOF compiler makes of them."""
