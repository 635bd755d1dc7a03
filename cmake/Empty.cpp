// Empty: headers that are compiled once need a target with a source.
