This is no message catalogue.
