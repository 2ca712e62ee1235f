INSERT INTO articles (title,body) VALUES ("Spring ""Garden"" Tips & Tricks ","Plant early.
Water <often> & well ]]> done. ");
INSERT INTO articles (title,body) VALUES ("Spring Garden Tip 2 & More","Plant ""early"" 2.
Water <often> & well. ");
