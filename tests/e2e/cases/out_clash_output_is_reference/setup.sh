cp ref.xml ref.before
