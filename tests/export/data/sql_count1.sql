INSERT INTO articles (title,body) VALUES ("Spring ""Garden"" Tips & Tricks ","Plant early.
Water <often> & well ]]> done. ");
